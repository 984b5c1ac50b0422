// The settings store of the application: the host's setting and preference repositories kept
// in two JSON files, the administrator's (defaults and locks) and the user's (the user's values).
#pragma once

#include "ZEPAppAtomicFile.h"
#include "ZEPAppSettingsFormat.h"
#include "ZEPSettings.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace zepapp {

inline constexpr const char* kSettingsFileEnv = "DRAFTING_OPTIONS_SETTINGS";
inline constexpr const char* kAdminFileEnv = "DRAFTING_OPTIONS_ADMIN";
inline constexpr const char* kAdminFileName = "drafting-options/admin.json"; // under each $XDG_CONFIG_DIRS folder

// How long a save waits for another process's save of the same file.
inline constexpr int kLockTimeoutMs = 5000;

struct ZEPAppSettingsPaths {
  std::string user;  // empty only when no home or config folder is known
  std::string admin; // never empty from ResolveSettingsPaths: the system-wide file at least
};

// Where the files are. The user's file: iUserOption, else $DRAFTING_OPTIONS_SETTINGS, else
// ($XDG_CONFIG_HOME or ~/.config)/drafting-options/settings.json. The administrator's file:
// iAdminOption (--admin FILE), else $DRAFTING_OPTIONS_ADMIN, else the system-wide
// drafting-options/admin.json of the first folder of $XDG_CONFIG_DIRS (default /etc/xdg) that
// has one, else of the first folder. Empty options and variables count as not given, so that
// leaving one out never drops the system-wide locks.
ZEPAppSettingsPaths ResolveSettingsPaths(const std::string& iUserOption = "", const std::string& iAdminOption = "");

inline constexpr std::size_t kAnyCount = std::size_t(-1);

// What a stored value must be to be used: its kind and count from the settings table and the
// limits of the control that shows it.
struct ZEPAppAttrRule {
  ZEPAppRepoKind kind = ZEPAppRepoKind::Setting;
  std::string repository, attribute;
  std::size_t type = 0;  // index of the alternative in ZEPAppValue: 0 double, 1 int, 2 unsigned, 3 text
  std::size_t count = 1; // how many values; kAnyCount: any number, none included (a list of texts)
  // Why a value of the right kind and count is refused; empty when it is accepted. May be
  // left empty: no limits.
  std::function<std::string(const ZEPAppValue&)> check;
};

// A change of the administrator's file: what Lock, Unlock, SetAdminDefault and
// RemoveAdminDefault do to one attribute.
enum class ZEPAppAdminAction { Lock, Unlock, Default, RemoveDefault };
struct ZEPAppAdminEdit {
  ZEPAppAdminAction action;
  std::string repository, attribute;
  std::optional<ZEPAppValue> value; // Lock: kept (none: the value it reads now); Default: needed
  ZEPAppRepoKind kind = ZEPAppRepoKind::Setting;
};

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

  // The rules the files' values are checked against when read. Repositories that no rule names
  // take any attribute; in those a rule names, an attribute without a rule is reported.
  void SetRules(std::vector<ZEPAppAttrRule> iRules);
  // How long a save waits for the lock of its file; kLockTimeoutMs unless changed.
  void SetLockTimeout(int iMilliseconds);

  // Reads both files into the repositories (a missing file is an empty one) and installs the
  // save handlers. iAdminPath empty: no administrator's file. E_FAIL when a file could not be
  // read; LoadErrors() then tells where and the faulty file is never written. A faulty user's
  // file contributes nothing. A faulty administrator's file stops every write, its own and the
  // user's (locks fail closed); what could be read of it still applies, locks included.
  long Load(const std::string& iUserPath, const std::string& iAdminPath = "");
  const std::vector<ZEPAppFileError>& LoadErrors() const;
  // Values of the user's file that are not used (wrong kind or count, outside the control's
  // limits, locked, unknown attribute): the default or the administrator's value shows
  // instead. They stay in the file until the user changes that setting.
  const std::vector<ZEPAppFileError>& LoadWarnings() const;
  // The first fault of the administrator's file; null when it could be read.
  const ZEPAppFileError* AdminFault() const;

  // The registered repository (opened when needed), filled from the files when it is new.
  ZEPSysSettingRepository* OpenSettings(const std::string& iName);
  ZEPSysPreferenceRepository* OpenPreferences(const std::string& iName);

  // Saves are read-modify-write under the lock of the file (ZEPAppFileLock): the file is read
  // again under the lock and only the attributes this run changed are applied to it, so that
  // concurrent runs changing other attributes lose nothing. A save that cannot get the lock
  // in time writes nothing and fails.
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
  // Drops the administrator's default of an attribute that is not locked. 1 when it had none
  // (nothing written); E_FAIL for a locked one (its value is the lock's: unlock it first).
  long RemoveAdminDefault(const std::string& iRepository, const std::string& iAttribute,
                          ZEPAppRepoKind iKind = ZEPAppRepoKind::Setting);
  // Several of those changes in one write of the administrator's file: all of them or none.
  // S_OK when something changed, 1 when none had anything to do (nothing written).
  long Administer(const std::vector<ZEPAppAdminEdit>& iEdits);
  // The administrator's file as last read or written.
  const ZEPAppSettingsDoc& AdminDoc() const;

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
