#include "ZEPAppServe.h"

#include "ZEPAppCli.h"
#include "ZEPAppInfo.h"
#include "ZEPAppKeys.h"
#include "ZEPAppServePage.h"
#include "ZEPAppStandards.h"

#include <httplib.h>

#include <atomic>
#include <cerrno>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <mutex>
#include <random>
#include <thread>

#include <csignal>
#include <fcntl.h>
#include <spawn.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

extern char** environ;

namespace zepapp {

namespace {

const char* const kLoopback = "127.0.0.1";

void CloseRepositories() {
  ZEPSysSettingRepository::CloseAll();
  ZEPSysPreferenceRepository::CloseAll();
}

// 128 bits from the system's random source, as hexadecimal.
std::string NewToken() {
  std::random_device random("/dev/urandom");
  std::string token;
  static const char* const kHex = "0123456789abcdef";
  for (int i = 0; i < 8; ++i) {
    const unsigned int v = random();
    for (int shift = 0; shift < 16; shift += 4) token += kHex[(v >> shift) & 0xF];
  }
  return token;
}

// Compares in a time that does not depend on where the texts differ.
bool SameSecret(const std::string& a, const std::string& b) {
  if (a.size() != b.size()) return false;
  unsigned char diff = 0;
  for (std::size_t i = 0; i < a.size(); ++i) diff |= static_cast<unsigned char>(a[i] ^ b[i]);
  return diff == 0;
}

std::string FileStamp(const std::string& iPath) {
  if (iPath.empty()) return "-";
  struct stat st {};
  if (stat(iPath.c_str(), &st) != 0) return "missing:" + std::to_string(errno);
  return std::to_string(st.st_dev) + ":" + std::to_string(st.st_ino) + ":" + std::to_string(st.st_size) + ":" +
         std::to_string(st.st_mtim.tv_sec) + "." + std::to_string(st.st_mtim.tv_nsec) + ":" +
         std::to_string(st.st_ctim.tv_sec) + "." + std::to_string(st.st_ctim.tv_nsec);
}

std::string Dump(const nlohmann::json& j) {
  return j.dump(-1, ' ', false, nlohmann::json::error_handler_t::replace);
}

// A request that cannot be served as asked: answered 400 with the reason.
struct BadRequest {
  std::string reason;
};

// The files loaded and the pages opened on them for one request, as one run of a command:
// every request starts from the files, so the page and the command line never disagree.
class LiveSession {
public:
  explicit LiveSession(const ZEPAppSettingsPaths& iPaths) {
    CloseRepositories();
    _rc = LoadSettingsFiles(_file, iPaths);
    _pRoot = std::make_unique<ZEPDlgWindow>(nullptr, "DraftingOptions", 0);
  }
  ~LiveSession() {
    _pRoot.reset(); // the pages go before the repositories they are bound to
    ZEPDlgDriver::Idle();
    CloseRepositories();
  }
  LiveSession(const LiveSession&) = delete;
  LiveSession& operator=(const LiveSession&) = delete;

  ZEPAppSettingsFile& File() { return _file; }
  bool Loaded() const { return SUCCEEDED(_rc); }

  // The page opened once, its controls showing iRanges' range for it.
  ZEPDlgFrame* Open(const ZEPAppPage& iPage, const ZEPAppRanges& iRanges, std::vector<ZEPAppControl>& oControls) {
    ZEPDlgFrame*& frame = _opened[iPage.name];
    if (!frame) frame = iPage.open(_pRoot.get());
    oControls = PageControls(frame, iPage.dialogButtons);
    const auto range = iRanges.find(iPage.name);
    if (range != iRanges.end() && ShownRange(oControls) && ShownRange(oControls) != range->second) {
      const ZEPAppOutcome outcome = SelectRange(oControls, range->second);
      if (outcome.code != kExitOk) throw BadRequest{iPage.name + ": " + outcome.message};
    }
    return frame;
  }

  // The faults of the files, as the command line reports them.
  nlohmann::json Problems() const {
    nlohmann::json errors = nlohmann::json::array(), warnings = nlohmann::json::array();
    for (const ZEPAppFileError& e : _file.LoadErrors()) errors.push_back(e.Text());
    for (const ZEPAppFileError& w : _file.LoadWarnings()) warnings.push_back(w.Text());
    return {{"errors", errors}, {"warnings", warnings}};
  }

private:
  ZEPAppSettingsFile _file;
  long _rc = S_OK;
  std::unique_ptr<ZEPDlgWindow> _pRoot;
  std::map<std::string, ZEPDlgFrame*> _opened;
};

// What the page's script needs beyond what show --json says of a control.
void AddLiveFields(const std::vector<ZEPAppControl>& iControls, const ZEPAppControl& iControl,
                   nlohmann::json& ioJson) {
  const std::vector<std::string> choices = iControl.ChoiceTexts();
  if (!choices.empty()) ioJson["choices"] = choices;
  // A button that takes a value offers a list to pick from; the pick sends its value.
  if (const std::vector<ZEPAppOffer> offers = OfferedValues(iControls, iControl); !offers.empty()) {
    nlohmann::json texts = nlohmann::json::array(), values = nlohmann::json::array();
    for (const ZEPAppOffer& o : offers) {
      texts.push_back(o.text);
      values.push_back(o.value);
    }
    ioJson["choices"] = std::move(texts);
    ioJson["values"] = std::move(values);
  }
  if (ZEPSysDynamicCast<ZEPComboColor>(iControl.inner)) ioJson["colour"] = true;
  if (auto* spinner = ZEPSysDynamicCast<ZEPDlgSpinner>(iControl.inner)) {
    double lo = 0, hi = 0, step = 0;
    spinner->GetMinMaxStep(lo, hi, step);
    const double shownStep = spinner->ToDisplay(step) - spinner->ToDisplay(0);
    if (step > 0 && std::isfinite(shownStep)) ioJson["step"] = shownStep;
  }
  ioJson["inDialog"] = iControl.subDialog != nullptr;
}

// Every page of the session: each drawn as render draws it, with its controls marked for the
// script, and each control as show --json describes it. oDocument: the whole dialog as well.
nlohmann::json PagesState(LiveSession& ioSession, const ZEPAppRanges& iRanges, const ZEPAppSettingsPaths& iPaths,
                          std::string* oDocument) {
  nlohmann::json pages = nlohmann::json::array();
  std::vector<ZEPAppRenderPage> rendered;
  for (const ZEPAppPage& page : AppPages()) {
    std::vector<ZEPAppControl> controls;
    ZEPDlgFrame* frame = ioSession.Open(page, iRanges, controls);
    ZEPAppRenderPage shown = RenderedPage(page, frame, controls);
    nlohmann::json list = nlohmann::json::array();
    for (const ZEPAppControl& c : controls) {
      shown.controlOf[c.inner] = c.name;
      nlohmann::json j = ControlJson(page, controls, c);
      AddLiveFields(controls, c, j);
      list.push_back(std::move(j));
    }
    pages.push_back({{"page", page.name},
                     {"title", page.title},
                     {"range", ShownRange(controls)},
                     {"html", RenderPageHtml(shown)},
                     {"controls", std::move(list)}});
    rendered.push_back(std::move(shown));
  }
  if (oDocument) {
    const ZEPAppFileError* fault = ioSession.File().AdminFault();
    const ZEPAppRenderContext context{iPaths.user, iPaths.admin, std::string(kAppName) + " " + kAppVersion,
                                      fault ? fault->Text() : ""};
    *oDocument = RenderHtml(rendered, context);
  }
  nlohmann::json state = ioSession.Problems();
  const ZEPAppFileError* fault = ioSession.File().AdminFault();
  state["adminFault"] = fault ? fault->Text() : "";
  state["settings"] = iPaths.user;
  state["admin"] = iPaths.admin;
  state["pages"] = std::move(pages);
  return state;
}

// ---- request bodies -----------------------------------------------------------------------------
nlohmann::json ParseBody(const httplib::Request& iRequest) {
  if (iRequest.body.empty()) return nlohmann::json::object();
  try {
    nlohmann::json body = nlohmann::json::parse(iRequest.body);
    if (!body.is_object()) throw BadRequest{"the request body must be a JSON object"};
    return body;
  } catch (const nlohmann::json::exception& e) {
    std::string what = e.what();
    if (auto at = what.find("] "); at != std::string::npos) what = what.substr(at + 2);
    throw BadRequest{"the request body is not valid JSON: " + what};
  }
}

std::string TextField(const nlohmann::json& iBody, const char* iName) {
  const auto it = iBody.find(iName);
  if (it == iBody.end() || it->is_null()) throw BadRequest{std::string("\"") + iName + "\" is missing"};
  if (it->is_string()) return it->get<std::string>();
  if (it->is_boolean()) return it->get<bool>() ? "on" : "off";
  if (it->is_number()) return it->dump();
  throw BadRequest{std::string("\"") + iName + "\" must be a text"};
}

ZEPAppRanges RangesField(const nlohmann::json& iBody) {
  ZEPAppRanges ranges;
  const auto it = iBody.find("ranges");
  if (it == iBody.end() || it->is_null()) return ranges;
  if (!it->is_object()) throw BadRequest{"\"ranges\" must be an object of page names and scale ranges"};
  for (const auto& [page, range] : it->items()) {
    if (!FindPage(page)) throw BadRequest{"\"ranges\": unknown page \"" + page + "\""};
    if (!range.is_number_integer() || range.get<long long>() < 1 || range.get<long long>() > 5)
      throw BadRequest{"\"ranges\": the scale range of " + page + " must be a whole number from 1 to 5"};
    ranges[page] = range.get<int>();
  }
  return ranges;
}

} // namespace

std::string SettingsStamp(const ZEPAppSettingsPaths& iPaths) {
  return FileStamp(iPaths.user) + "|" + FileStamp(iPaths.admin);
}

// ---- the server ----------------------------------------------------------------------------------
struct ZEPAppServer::Impl {
  ZEPAppSettingsPaths paths;
  std::string plmRepository;
  std::string token = NewToken();
  httplib::Server http;
  std::thread thread;
  std::atomic<int> port{0};
  std::atomic<bool> running{false};
  // The host stand-in is single-threaded, like the real framework's user-interface thread:
  // every page, driver and store operation of every request runs under this one lock.
  std::mutex work;

  bool Allowed(const httplib::Request& iRequest, std::string& oWhy) const {
    const std::string host = iRequest.get_header_value("Host");
    if (host != kLoopback && host != std::string(kLoopback) + ":" + std::to_string(port.load())) {
      oWhy = "this server answers requests for " + std::string(kLoopback) + " only";
      return false;
    }
    std::string given = iRequest.get_param_value("token");
    if (given.empty()) given = iRequest.get_header_value("X-Token");
    if (!SameSecret(given, token)) {
      oWhy = "the token is missing or wrong: open the address that drafting-options serve printed";
      return false;
    }
    return true;
  }

  // The dialog as a page of its own, with its live script.
  std::string Document() {
    std::lock_guard<std::mutex> lock(work);
    LiveSession session(paths);
    std::string document;
    PagesState(session, {}, paths, &document);
    return document;
  }

  nlohmann::json State(const ZEPAppRanges& iRanges) {
    std::lock_guard<std::mutex> lock(work);
    return StateLocked(iRanges);
  }

  nlohmann::json StateLocked(const ZEPAppRanges& iRanges) {
    // The stamp before reading: a write in between shows as a newer stamp at the next poll.
    const std::string stamp = SettingsStamp(paths);
    std::string unusable; // said when a standard is added; the page then offers none
    LoadPLMRepository(plmRepository, unusable);
    LiveSession session(paths);
    nlohmann::json state = PagesState(session, iRanges, paths, nullptr);
    state["stamp"] = stamp;
    return state;
  }

  // The set command's path, on the files as they are now.
  nlohmann::json Change(const std::string& iPage, const std::string& iControl, const std::string& iValue,
                        ZEPAppRanges iRanges) {
    std::lock_guard<std::mutex> lock(work);
    const ZEPAppPage* page = FindPage(iPage);
    if (!page) {
      std::vector<std::string> names;
      for (const ZEPAppPage& p : AppPages()) names.push_back(p.name);
      throw BadRequest{"unknown page \"" + iPage + "\"." + DidYouMean(iPage, names)};
    }
    ZEPAppOutcome outcome;
    {
      LiveSession session(paths);
      std::vector<ZEPAppControl> controls;
      session.Open(*page, iRanges, controls);
      const ZEPAppControl* control = FindPageControl(controls, iControl);
      if (!control) {
        std::vector<std::string> names;
        for (const ZEPAppControl& c : controls) names.push_back(c.name);
        throw BadRequest{"unknown control \"" + iControl + "\" on page " + page->name + "." +
                         DidYouMean(iControl, names)};
      }
      if (!session.Loaded()) { // as for every command that writes: faulty files stop it
        outcome.code = kExitFile;
        const nlohmann::json problems = session.Problems();
        for (const auto& e : problems["errors"]) outcome.message += e.get<std::string>() + "\n";
        outcome.message += "nothing was changed; correct or remove the faulty file, then try again";
      } else {
        outcome = ChangeSetting(session.File(), controls, *control, iValue, plmRepository);
        if (const int range = ShownRange(controls)) iRanges[page->name] = range; // the range combo
      }
    }
    return {{"ok", outcome.code == kExitOk},
            {"code", outcome.code},
            {"changed", outcome.changed},
            {"message", outcome.message},
            {"warning", outcome.warning},
            {"page", page->name},
            {"control", iControl},
            {"state", StateLocked(iRanges)}};
  }

  void Routes() {
    http.set_payload_max_length(kServeMaxBody);
    // The library's own socket options add SO_REUSEPORT, with which a second program of the
    // same user binds the very port this one listens on and takes part of its requests.
    http.set_socket_options([](socket_t iSocket) {
      const int yes = 1;
      setsockopt(iSocket, SOL_SOCKET, SO_REUSEADDR, &yes, sizeof yes);
    });
    // An idle connection the browser keeps open holds a thread until this runs out, and the
    // server's end waits for every thread: one second, still more than the page's polling.
    http.set_keep_alive_timeout(1);
    http.set_read_timeout(2); // a request on the loopback arrives at once
    http.set_default_headers({{"X-Content-Type-Options", "nosniff"},
                              {"Cache-Control", "no-store"},
                              {"Referrer-Policy", "no-referrer"},
                              {"X-Frame-Options", "DENY"}});
    http.set_pre_routing_handler([this](const httplib::Request& req, httplib::Response& res) {
      std::string why;
      if (Allowed(req, why)) {
        // The library would compress with gzip or Brotli when the browser offers them: on the
        // loopback that costs more time than it saves (a state: 20 ms plain, 60 ms with gzip,
        // 600 ms with Brotli at the library's fixed quality). Answers go uncompressed.
        auto& headers = const_cast<httplib::Request&>(req).headers; // the library's own request object
        for (auto at = headers.find("Accept-Encoding"); at != headers.end(); at = headers.find("Accept-Encoding"))
          headers.erase(at);
        return httplib::Server::HandlerResponse::Unhandled;
      }
      res.status = 403;
      res.set_content(why + "\n", "text/plain; charset=utf-8");
      return httplib::Server::HandlerResponse::Handled;
    });
    http.set_error_handler([](const httplib::Request&, httplib::Response& res) {
      if (!res.body.empty()) return;
      std::string text = "the request could not be served";
      if (res.status == 404) text = "nothing here: this server answers its own page and API only";
      if (res.status == 405) text = "that method is not used here";
      if (res.status == 413) text = "the request body is larger than " + std::to_string(kServeMaxBody / 1024) + " KiB";
      if (res.status == 400) text = "the request is malformed";
      res.set_content(Dump({{"error", text}}), "application/json");
    });
    http.set_exception_handler([](const httplib::Request&, httplib::Response& res, std::exception_ptr ep) {
      std::string what = "unexpected failure";
      try {
        if (ep) std::rethrow_exception(ep);
      } catch (const BadRequest& e) {
        res.status = 400;
        res.set_content(Dump({{"error", e.reason}}), "application/json");
        return;
      } catch (const std::exception& e) {
        what += std::string(": ") + e.what();
      } catch (...) {
      }
      res.status = 500;
      res.set_content(Dump({{"error", what}}), "application/json");
    });

    http.Get("/", [this](const httplib::Request&, httplib::Response& res) {
      const std::string nonce = NewToken();
      res.set_header("Content-Security-Policy",
                     "default-src 'none'; style-src 'unsafe-inline'; img-src data:; connect-src 'self'; "
                     "script-src 'nonce-" + nonce + "'; base-uri 'none'; form-action 'none'; frame-ancestors 'none'");
      res.set_content(LivePage(Document(), token, nonce), "text/html; charset=utf-8");
    });
    http.Get("/api/stamp", [this](const httplib::Request&, httplib::Response& res) {
      res.set_content(Dump({{"stamp", SettingsStamp(paths)}}), "application/json");
    });
    http.Post("/api/state", [this](const httplib::Request& req, httplib::Response& res) {
      const nlohmann::json body = ParseBody(req);
      res.set_content(Dump(State(RangesField(body))), "application/json");
    });
    http.Post("/api/change", [this](const httplib::Request& req, httplib::Response& res) {
      const nlohmann::json body = ParseBody(req);
      const std::string page = TextField(body, "page"), control = TextField(body, "control");
      const std::string value = TextField(body, "value");
      res.set_content(Dump(Change(page, control, value, RangesField(body))), "application/json");
    });
  }
};

ZEPAppServer::ZEPAppServer(ZEPAppSettingsPaths iPaths, const std::string& iPLMRepository)
    : _pImpl(std::make_unique<Impl>()) {
  _pImpl->paths = std::move(iPaths);
  _pImpl->plmRepository = ResolvePLMRepository(iPLMRepository);
  _pImpl->Routes();
}

ZEPAppServer::~ZEPAppServer() { Stop(); }

bool ZEPAppServer::Start(int iPort, std::string& oError) {
  Impl& s = *_pImpl;
  if (s.running) return true;
  if (iPort < 0 || iPort > 65535) {
    oError = "the port must be from 1 to 65535 (0: a free one)";
    return false;
  }
  errno = 0;
  const int port = iPort == 0 ? s.http.bind_to_any_port(kLoopback)
                              : (s.http.bind_to_port(kLoopback, iPort) ? iPort : -1);
  if (port <= 0) {
    oError = std::string("cannot listen on ") + kLoopback + ":" + std::to_string(iPort) +
             (errno ? std::string(": ") + std::strerror(errno) : std::string());
    return false;
  }
  s.port = port;
  s.running = true;
  s.thread = std::thread([&s] {
    s.http.listen_after_bind();
    s.running = false;
  });
  return true;
}

void ZEPAppServer::Stop() {
  Impl& s = *_pImpl;
  if (!s.thread.joinable()) return;
  {
    // Lets the change being worked on finish before the server goes down.
    std::lock_guard<std::mutex> lock(s.work);
    s.http.stop();
  }
  s.thread.join(); // the pool's threads end with their requests
  s.running = false;
}

bool ZEPAppServer::Running() const { return _pImpl->running; }
int ZEPAppServer::Port() const { return _pImpl->port; }
const std::string& ZEPAppServer::Token() const { return _pImpl->token; }
std::string ZEPAppServer::Url() const {
  return std::string("http://") + kLoopback + ":" + std::to_string(Port()) + "/?token=" + Token();
}

// ---- the command -------------------------------------------------------------------------------
namespace {

// Asks the desktop to open the page. The address is handed over in a file only the user can
// read, so that the token does not show in the process list; it is removed with oFolder.
pid_t OpenInBrowser(const std::string& iUrl, std::string& oFolder) {
  std::string pattern = (std::filesystem::temp_directory_path() / "drafting-options-XXXXXX").string();
  if (!mkdtemp(pattern.data())) return -1;
  oFolder = pattern;
  const std::string file = oFolder + "/open.html";
  const std::string url = EscapeHtml(iUrl);
  const std::string page = "<!DOCTYPE html><meta charset=\"utf-8\"><meta http-equiv=\"refresh\" content=\"0;url=" +
                           url + "\"><title>Drafting options</title><a href=\"" + url + "\">Drafting options</a>\n";
  const int fd = open(file.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0600);
  if (fd < 0) return -1;
  const bool written = write(fd, page.data(), page.size()) == static_cast<ssize_t>(page.size());
  close(fd);
  if (!written) return -1;
  posix_spawn_file_actions_t actions;
  posix_spawn_file_actions_init(&actions);
  posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
  posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
  posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, "/dev/null", O_WRONLY, 0);
  const std::string target = "file://" + file;
  char* const argv[] = {const_cast<char*>("xdg-open"), const_cast<char*>(target.c_str()), nullptr};
  pid_t pid = -1;
  if (posix_spawnp(&pid, "xdg-open", &actions, nullptr, argv, environ) != 0) pid = -1;
  posix_spawn_file_actions_destroy(&actions);
  return pid;
}

} // namespace

int RunServe(const ZEPAppSettingsPaths& iPaths, const ZEPAppServeOptions& iOptions, std::ostream& out,
             std::ostream& err) {
  if (const std::string why = UseStandardsFolder(ResolveStandardsFolder(iOptions.standards)); !why.empty())
    err << "warning: " << why << "\n";
  {
    // The files as a reading command loads them: faults are warnings, an unreadable file stops.
    LiveSession session(iPaths);
    const nlohmann::json problems = session.Problems();
    for (const auto& w : problems["warnings"]) err << "warning: " << w.get<std::string>() << "\n";
    bool unreadable = false;
    for (const ZEPAppFileError& e : session.File().LoadErrors()) unreadable = unreadable || e.unreadable;
    for (const auto& e : problems["errors"]) err << (unreadable ? "error: " : "warning: ") << e.get<std::string>() << "\n";
    if (unreadable) return kExitFile;
    if (!session.Loaded())
      err << "warning: no change is accepted until the faulty file is corrected\n";
  }
  // SIGINT and SIGTERM are taken by this thread alone: the server's threads, started with them
  // blocked, never see them.
  sigset_t stopSignals, previous;
  sigemptyset(&stopSignals);
  sigaddset(&stopSignals, SIGINT);
  sigaddset(&stopSignals, SIGTERM);
  pthread_sigmask(SIG_BLOCK, &stopSignals, &previous);
  std::signal(SIGPIPE, SIG_IGN); // a browser that goes away mid-answer
  int rc = kExitOk;
  {
    ZEPAppServer server(iPaths, iOptions.plmRepository);
    std::string error;
    if (!server.Start(iOptions.port, error)) {
      err << "error: " << error << "\n";
      rc = kExitFailure;
    } else {
      out << "The drafting options dialog is served at\n  " << server.Url() << "\n"
          << "settings: " << (iPaths.user.empty() ? "none" : iPaths.user) << "\n"
          << "administrator's settings: " << (iPaths.admin.empty() ? "none" : iPaths.admin) << "\n"
          << "Stop it with Ctrl+C." << std::endl;
      std::string folder;
      pid_t opener = iOptions.open ? OpenInBrowser(server.Url(), folder) : -1;
      if (iOptions.open && opener < 0)
        out << "(no browser could be opened: open the address above yourself)" << std::endl;
      while (server.Running()) {
        const timespec wait{0, 200 * 1000 * 1000};
        if (sigtimedwait(&stopSignals, nullptr, &wait) > 0) break;
        if (opener > 0 && waitpid(opener, nullptr, WNOHANG) != 0) opener = -1;
      }
      if (!server.Running()) {
        err << "error: the server stopped on its own\n";
        rc = kExitFailure;
      }
      server.Stop();
      if (opener > 0) waitpid(opener, nullptr, WNOHANG);
      std::error_code ec;
      if (!folder.empty()) std::filesystem::remove_all(folder, ec);
      out << "Stopped." << std::endl;
    }
  }
  pthread_sigmask(SIG_SETMASK, &previous, nullptr);
  return rc;
}

} // namespace zepapp
