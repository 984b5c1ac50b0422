// The settings store of the application: the host's setting and preference repositories kept
// in two JSON files, the administrator's (defaults and locks) and the user's (the user's values).
#pragma once

#include "ZEPAppAtomicFile.h"
#include "ZEPAppSettingsFormat.h"
#include "ZEPSettings.h"

#include <memory>
#include <string>
#include <vector>

namespace zepapp {

inline constexpr const char* kSettingsFileEnv = "DRAFTING_OPTIONS_SETTINGS";
inline constexpr const char* kAdminFileEnv = "DRAFTING_OPTIONS_ADMIN";

struct ZEPAppSettingsPaths {
  std::string user;  // empty only when no home or config folder is known
  std::string admin; // empty: no administrator's file
};

// Where the files are. The user's file: iUserOption, else $DRAFTING_OPTIONS_SETTINGS, else
// ($XDG_CONFIG_HOME or ~/.config)/drafting-options/settings.json. The administrator's file:
// iAdminOption (--admin FILE), else $DRAFTING_OPTIONS_ADMIN, else none. Empty options and
// variables count as not given.
ZEPAppSettingsPaths ResolveSettingsPaths(const std::string& iUserOption = "", const std::string& iAdminOption = "");

// The login name that a lock records as its author.
std::string CurrentUserName();

// Binds the host repositories to the files. Every repository the application uses must be
// opened through OpenSettings/OpenPreferences (or appear in a file) so that its SaveRepository
// writes the user's file. Saving one repository writes its values and keeps the others as last
// saved. Statuses: S_OK, or E_FAIL with LastError() saying why.
class ZEPAppSettingsFile {
public:
  // iOps: the file operations saves go through; the POSIX ones when null.
  explicit ZEPAppSettingsFile(std::shared_ptr<ZEPAppFileOps> iOps = nullptr);
  ~ZEPAppSettingsFile();
  ZEPAppSettingsFile(const ZEPAppSettingsFile&) = delete;
  ZEPAppSettingsFile& operator=(const ZEPAppSettingsFile&) = delete;

  // Reads both files into the repositories (a missing file is an empty one) and installs the
  // save handlers. iAdminPath empty: no administrator's file. E_FAIL when a file could not be
  // read; LoadErrors() then tells where, everything of the other file is still applied, and the
  // faulty file is never written.
  long Load(const std::string& iUserPath, const std::string& iAdminPath = "");
  const std::vector<ZEPAppFileError>& LoadErrors() const;

  // The registered repository (opened when needed), filled from the files when it is new.
  ZEPSysSettingRepository* OpenSettings(const std::string& iName);
  ZEPSysPreferenceRepository* OpenPreferences(const std::string& iName);

  // SaveRepository of every repository bound to the files; the first failure is kept.
  long SaveAll();

  // Administrator's file. Locking records the current user and keeps the attribute at iValue,
  // or else at the value it reads now (none: the application's own default).
  long Lock(const std::string& iRepository, const std::string& iAttribute,
            ZEPAppRepoKind iKind = ZEPAppRepoKind::Setting);
  long Lock(const std::string& iRepository, const std::string& iAttribute, const ZEPAppValue& iValue,
            ZEPAppRepoKind iKind = ZEPAppRepoKind::Setting);
  // The administrator's value stays as a default. 1 when it was not locked (nothing written).
  long Unlock(const std::string& iRepository, const std::string& iAttribute,
              ZEPAppRepoKind iKind = ZEPAppRepoKind::Setting);
  long SetAdminDefault(const std::string& iRepository, const std::string& iAttribute, const ZEPAppValue& iValue,
                       ZEPAppRepoKind iKind = ZEPAppRepoKind::Setting);

  // User's file: drops the user's value so that the default shows again, and saves. A locked
  // attribute is refused; ResetAll leaves locked attributes as they are.
  long Reset(const std::string& iRepository, const std::string& iAttribute,
             ZEPAppRepoKind iKind = ZEPAppRepoKind::Setting);
  long ResetAll(const std::string& iRepository, ZEPAppRepoKind iKind = ZEPAppRepoKind::Setting);
  // Every repository of both kinds.
  long ResetAll();

  // Why the last operation (or the last save of a repository) failed; empty after a success.
  const std::string& LastError() const;
  const std::string& UserPath() const;
  const std::string& AdminPath() const;
  // The text a padlock shows for a lock by iWho in the administrator's file.
  std::string LockText(const std::string& iWho) const;

private:
  struct Impl;
  std::shared_ptr<Impl> _pImpl; // save handlers hold it weakly and fail once it is gone
};

} // namespace zepapp
