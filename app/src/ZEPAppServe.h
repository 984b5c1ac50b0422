// The live options dialog, drafting-options serve: an HTTP server on the loopback address that
// draws the pages as render does and operates their controls as set does, each change saved at
// once; the open page follows what other programs change in the settings files.
#pragma once

#include "ZEPAppSettingsFile.h"

#include <nlohmann/json.hpp>

#include <cstddef>
#include <map>
#include <memory>
#include <ostream>
#include <string>

namespace zepapp {

// The largest request body taken; a larger one is answered 413.
inline constexpr std::size_t kServeMaxBody = 64 * 1024;

// The scale range each page shows (page name to 1..5); a page left out shows the one it opens on.
using ZEPAppRanges = std::map<std::string, int>;

// The server. Every request needs the token (query parameter token, or header X-Token) and
// a Host header naming 127.0.0.1; anything else is answered 403. It answers:
//   GET  /             the dialog, as render draws it, with the script that makes it live
//   GET  /api/stamp    {"stamp"}: changes whenever either settings file changes
//   POST /api/state    {"ranges"?}  ->  the state of every page (StateJson)
//   POST /api/change   {"page", "control", "value", "ranges"?}  ->  {"ok", "code", "message",
//                      "page", "control", "state"}: the control operated as set does
// Malformed bodies are answered 400 with {"error"}. Nothing else is served: no request reaches
// the file system beyond the two settings files.
class ZEPAppServer {
public:
  // iPLMRepository: the PLM repository file the chooser lists, as --plm-repository gives it
  // (empty: the environment's or the shipped one).
  explicit ZEPAppServer(ZEPAppSettingsPaths iPaths, const std::string& iPLMRepository = "");
  ~ZEPAppServer(); // stops
  ZEPAppServer(const ZEPAppServer&) = delete;
  ZEPAppServer& operator=(const ZEPAppServer&) = delete;

  // Listens on 127.0.0.1:iPort (0: a free port) and serves on threads of its own. False with
  // oError when the port cannot be had.
  bool Start(int iPort, std::string& oError);
  // Stops listening, lets the requests being worked on finish (a save is never cut short)
  // and returns once every thread of the server has ended.
  void Stop();
  bool Running() const;
  int Port() const;
  const std::string& Token() const;
  // http://127.0.0.1:PORT/?token=TOKEN
  std::string Url() const;

private:
  struct Impl;
  std::unique_ptr<Impl> _pImpl;
};

// What identifies the current contents of both files (device, inode, size, modification and
// change times): it differs as soon as either file is written, replaced, created or removed.
std::string SettingsStamp(const ZEPAppSettingsPaths& iPaths);

struct ZEPAppServeOptions {
  int port = 0;      // 0: a free port
  bool open = true;  // ask the desktop to open the page
  std::string standards, plmRepository; // --standards and --plm-repository as given
};

// The serve command: loads the files once as reading commands do (a file that cannot be read
// at all stops it with kExitFile), prints the address with its token, asks the desktop to open
// it, and serves until SIGINT or SIGTERM; then kExitOk.
int RunServe(const ZEPAppSettingsPaths& iPaths, const ZEPAppServeOptions& iOptions, std::ostream& out,
             std::ostream& err);

} // namespace zepapp
