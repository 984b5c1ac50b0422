#include "ZEPAppSettingsFile.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iterator>
#include <optional>
#include <map>
#include <set>
#include <tuple>
#include <system_error>
#include <utility>
#include <variant>

#include <pwd.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace zepapp {

namespace {

// Settings files are a few kilobytes; a huge file is a mistake, not something to load.
constexpr std::uintmax_t kMaxFileSize = 16u << 20;

std::string Env(const char* iName) {
  const char* v = std::getenv(iName);
  return v ? v : "";
}

std::string HomeFolder() {
  std::string home = Env("HOME");
  if (!home.empty()) return home;
  const passwd* pw = ::getpwuid(::getuid());
  return pw && pw->pw_dir ? pw->pw_dir : "";
}

// Only regular files are read, and at most kMaxFileSize bytes of them.
bool ReadFile(const std::string& iPath, std::string& oText, bool& oExists, ZEPAppFileError& oError) {
  oError = ZEPAppFileError{iPath, 0, 0, "", true};
  return ReadRegularFile(iPath, kMaxFileSize, oText, oExists, oError.message);
}

// By index of the alternative in ZEPAppValue.
const char* const kTypeNames[] = {"double", "int", "unsigned", "text"};
static_assert(std::size(kTypeNames) == std::variant_size_v<ZEPAppValue>);

// The system-wide administrator's file: the first folder of $XDG_CONFIG_DIRS that has one,
// else where the first folder would hold it.
std::string SystemAdminFile() {
  std::string dirs = Env("XDG_CONFIG_DIRS");
  if (dirs.empty()) dirs = "/etc/xdg";
  std::string first;
  std::size_t from = 0;
  while (from <= dirs.size()) {
    std::size_t to = dirs.find(':', from);
    if (to == std::string::npos) to = dirs.size();
    const std::string dir = dirs.substr(from, to - from);
    from = to + 1;
    if (dir.empty() || dir[0] != '/') continue; // XDG asks to ignore relative folders
    const std::string file = dir + "/" + kAdminFileName;
    std::error_code ec;
    if (fs::exists(fs::symlink_status(file, ec))) return file;
    if (first.empty()) first = file;
  }
  return first.empty() ? std::string("/etc/xdg/") + kAdminFileName : first;
}

ZEPSysSettingRepository* Find(ZEPAppRepoKind iKind, const std::string& iName) {
  if (iKind == ZEPAppRepoKind::Setting) return ZEPSysSettingRepository::GetRepository(iName.c_str());
  return ZEPSysPreferenceRepository::GetPreferenceRepository(iName.c_str());
}

const char* SectionName(ZEPAppRepoKind iKind) {
  return iKind == ZEPAppRepoKind::Setting ? "settings" : "preferences";
}

bool EntryEmpty(const ZEPAppAttrEntry& e) { return !e.value && !e.locked && e.by.empty(); }

} // namespace

ZEPAppSettingsPaths ResolveSettingsPaths(const std::string& iUserOption, const std::string& iAdminOption) {
  ZEPAppSettingsPaths paths;
  paths.user = !iUserOption.empty() ? iUserOption : Env(kSettingsFileEnv);
  if (paths.user.empty()) {
    // XDG asks to ignore a relative XDG_CONFIG_HOME.
    std::string base = Env("XDG_CONFIG_HOME");
    if (base.empty() || base[0] != '/') {
      std::string home = HomeFolder();
      base = home.empty() ? "" : home + "/.config";
    }
    if (!base.empty()) paths.user = base + "/drafting-options/settings.json";
  }
  paths.admin = !iAdminOption.empty() ? iAdminOption : Env(kAdminFileEnv);
  if (paths.admin.empty()) paths.admin = SystemAdminFile();
  return paths;
}

std::string CurrentUserName() {
  for (const char* var : {"USER", "LOGNAME", "USERNAME"}) {
    std::string name = Env(var);
    if (!name.empty()) return name;
  }
  const passwd* pw = ::getpwuid(::geteuid());
  return pw && pw->pw_name ? pw->pw_name : "uid " + std::to_string(::geteuid());
}

// ---- the store --------------------------------------------------------------------------------
struct ZEPAppSettingsFile::Impl : std::enable_shared_from_this<Impl> {
  using RepoKey = std::pair<ZEPAppRepoKind, std::string>;
  using AttrKey = std::tuple<ZEPAppRepoKind, std::string, std::string>;

  // One settings file as last read or written.
  struct File {
    std::string path;
    ZEPAppSettingsDoc doc;
    std::string bytes; // what the file holds
    // Whether doc holds what bytes say. A sound user's file is loaded without a document
    // (its values go straight to the repositories); Doc() reads one when it is needed.
    bool parsed = true;
    bool onDisk = false;
    std::optional<ZEPAppFileError> fault; // set when it could not be read: never written then
    std::set<AttrKey> unusable;           // values reported and not applied
    // Where each attribute of doc lies in bytes, when bytes were written from doc by this run
    // (empty otherwise): a save then rewrites only the entries it changes.
    ZEPAppTextLayout layout;
  };

  std::shared_ptr<ZEPAppFileOps> ops;
  File user, admin;
  std::string adminWhere; // absolute path shown in lock texts
  std::vector<ZEPAppFileError> loadErrors, loadWarnings;
  std::string lastError;
  std::set<RepoKey> bound;
  std::map<AttrKey, ZEPAppAttrRule> rules;
  std::set<RepoKey> ruled; // repositories some rule names
  int lockTimeoutMs = kLockTimeoutMs;
  // The values of the user's file a quick load read, until each repository takes its own.
  ZEPAppSettingsValues loaded;
  std::set<RepoKey> handedOut; // repositories of `loaded` whose values have gone to the repository
  // What each repository was given from the user's file, and attributes reset since: a save
  // writes only what differs from it, over what the file holds then. That is the usable values
  // of the user's document, until the document is read again with something another process
  // wrote: just before, what the repositories were given is copied here (rarely), and the
  // document no longer tells it.
  std::map<RepoKey, std::map<std::string, ZEPAppValue>> baseline;
  std::map<RepoKey, std::set<std::string>> erased;
  // Whether `loaded` names every repository of the user's file as it is now (a quick load,
  // and the bytes not replaced since): a repository it does not name has nothing in the file.
  bool quickLoad = false;

  long Fail(std::string iWhy) {
    lastError = std::move(iWhy);
    return E_FAIL;
  }

  std::string LockText(const std::string& iWho) const {
    return "Locked by " + (iWho.empty() ? std::string("an administrator") : iWho) + " in " + adminWhere;
  }

  const ZEPAppAttrEntry* AdminEntry(ZEPAppRepoKind iKind, const std::string& iRepo, const std::string& iAttr) const {
    const auto& repos = admin.doc.Of(iKind);
    auto repo = repos.find(iRepo);
    if (repo == repos.end()) return nullptr;
    auto it = repo->second.find(iAttr);
    return it == repo->second.end() ? nullptr : &it->second;
  }

  // Why iValue cannot be the value of the attribute; empty when it can.
  std::string Verdict(const ZEPAppAttrRule& iRule, const ZEPAppValue& iValue) const {
    if (iValue.index() != iRule.type && iRule.type < std::size(kTypeNames))
      return std::string("holds \"") + kTypeNames[iValue.index()] + "\" values, expected \"" +
             kTypeNames[iRule.type] + "\"";
    const std::size_t n = std::visit([](const auto& v) { return v.size(); }, iValue);
    if (n != iRule.count && iRule.count != kAnyCount)
      return "holds " + std::to_string(n) + (n == 1 ? " value" : " values") + ", expected " +
             std::to_string(iRule.count);
    return iRule.check ? iRule.check(iValue) : std::string();
  }

  static const ZEPAppValue* ValueOf(const ZEPAppAttrEntry& iEntry) { return iEntry.value ? &*iEntry.value : nullptr; }
  static const ZEPAppValue* ValueOf(const ZEPAppValue& iValue) { return &iValue; }
  static bool LockedIn(const ZEPAppAttrEntry& iEntry) { return iEntry.locked; }
  static bool LockedIn(const ZEPAppValue&) { return false; }

  // Checks what a file that parsed holds (iDoc: its document, or the values a quick load read)
  // against the rules and the locks, notes the values not to apply and answers what it found,
  // in text order.
  template <class Doc> std::vector<ZEPAppFileError> CheckValues(File& ioFile, bool iAdmin, const Doc& iDoc) {
    ioFile.unusable.clear();
    std::vector<ZEPAppPlacedMessage> found;
    for (ZEPAppRepoKind kind : {ZEPAppRepoKind::Setting, ZEPAppRepoKind::Preference}) {
      const char* section = kind == ZEPAppRepoKind::Setting ? "settings" : "preferences";
      for (const auto& [repo, entries] : iDoc.Of(kind)) {
        // Looked up once per repository; the messages are built only for what is reported.
        const bool isRuled = ruled.count({kind, repo}) != 0;
        const ZEPAppRepoEntries* admins = nullptr;
        if (!iAdmin)
          if (auto a = admin.doc.Of(kind).find(repo); a != admin.doc.Of(kind).end()) admins = &a->second;
        if (!isRuled && !admins) continue; // nothing to hold the values to
        for (const auto& [attr, entry] : entries) {
          auto rule = isRuled ? rules.find({kind, repo, attr}) : rules.end();
          if (isRuled && rule == rules.end()) {
            found.push_back({JsonPointer({section, repo, attr}), true,
                             std::string(section) + "/" + repo + "/" + attr + ": unknown attribute; nothing reads it" +
                                 (iAdmin ? ", so neither its value nor its lock applies" : "")});
            ioFile.unusable.insert({kind, repo, attr});
            continue;
          }
          const ZEPAppValue* value = ValueOf(entry);
          if (!value) continue;
          std::string why = rule == rules.end() ? std::string() : Verdict(rule->second, *value);
          const ZEPAppAttrEntry* byAdmin = nullptr;
          if (admins)
            if (auto a = admins->find(attr); a != admins->end()) byAdmin = &a->second;
          if (why.empty() && byAdmin && byAdmin->locked)
            why = "is locked (" + LockText(byAdmin->by) + "); this value is ignored";
          else if (!why.empty())
            why += iAdmin ? (LockedIn(entry) ? "; the lock holds at the application's default" : "; not used")
                          : (byAdmin && byAdmin->value ? "; the administrator's value is used instead"
                                                       : "; the default is used instead");
          if (why.empty()) continue;
          found.push_back({JsonPointer({section, repo, attr, kTypeNames[value->index()]}), false,
                           std::string(section) + "/" + repo + "/" + attr + ": " + why});
          ioFile.unusable.insert({kind, repo, attr});
        }
      }
    }
    std::vector<ZEPAppFileError> placed = PlaceMessages(ioFile.bytes, ioFile.path, found);
    std::stable_sort(placed.begin(), placed.end(), [](const ZEPAppFileError& a, const ZEPAppFileError& b) {
      return std::tie(a.line, a.column) < std::tie(b.line, b.column);
    });
    // For the administrator's file these are faults: a lock must not silently vanish.
    if (iAdmin && !placed.empty() && !ioFile.fault) ioFile.fault = placed.front();
    return placed;
  }

  // The document of a file, read from its bytes the first time it is needed after a quick
  // load. Those bytes read soundly once; should they not now, the file is treated as faulty
  // (never written) rather than as empty.
  ZEPAppSettingsDoc& Doc(File& ioFile) {
    if (ioFile.parsed) return ioFile.doc;
    ioFile.parsed = true;
    std::vector<ZEPAppFileError> faults = ParseSettingsText(ioFile.bytes, ioFile.path, &ioFile == &admin, ioFile.doc);
    if (!faults.empty() && !ioFile.fault) ioFile.fault = faults.front();
    return ioFile.doc;
  }

  // Whether an attribute of the user's document was left out of its repository.
  bool Unusable(const RepoKey& iRepo, const std::string& iAttr) const {
    return !user.unusable.empty() && user.unusable.count({iRepo.first, iRepo.second, iAttr}) != 0;
  }

  // Before the user's document is replaced by what another process wrote: what each
  // repository was given is kept apart.
  void KeepBaselines() {
    for (const RepoKey& key : bound) {
      if (baseline.count(key)) continue;
      std::map<std::string, ZEPAppValue>& kept = baseline[key];
      const auto& repos = Doc(user).Of(key.first);
      auto it = repos.find(key.second);
      if (it == repos.end()) continue;
      for (const auto& [attr, entry] : it->second)
        if (entry.value && !Unusable(key, attr)) kept.emplace_hint(kept.end(), attr, *entry.value);
    }
  }

  // Reads and parses one file into ioFile. False with the faults when it could not be read.
  // oValues (loading the user's file): a sound file's values go there, without a document.
  bool ReadInto(File& ioFile, bool iAdmin, std::vector<ZEPAppFileError>& oFaults,
                ZEPAppSettingsValues* oValues = nullptr) {
    try {
      ZEPAppFileError err;
      std::string bytes;
      bool onDisk = false;
      const bool read = ReadFile(ioFile.path, bytes, onDisk, err);
      // The bytes this run read or wrote last, read again (a save under the lock when no one
      // else wrote meanwhile): the content is the same, there is nothing to parse.
      if (read && onDisk && ioFile.onDisk && !ioFile.fault && bytes == ioFile.bytes) return true;
      if (&ioFile == &user) {
        KeepBaselines();
        quickLoad = false;
      }
      ioFile.doc = ZEPAppSettingsDoc();
      ioFile.layout.clear();
      ioFile.parsed = true;
      ioFile.bytes = std::move(bytes);
      ioFile.onDisk = onDisk;
      ioFile.fault.reset();
      if (!read) {
        oFaults.push_back(err);
      } else if (oValues && ReadSettingsValues(ioFile.bytes, *oValues)) {
        ioFile.parsed = false;
        quickLoad = true;
      } else {
        if (oValues) *oValues = ZEPAppSettingsValues();
        std::vector<ZEPAppFileError> faults = ParseSettingsText(ioFile.bytes, ioFile.path, iAdmin, ioFile.doc);
        oFaults.insert(oFaults.end(), faults.begin(), faults.end());
      }
    } catch (const std::exception& ex) { // out of memory and the like: still a report, not a crash
      ioFile.doc = ZEPAppSettingsDoc();
      ioFile.layout.clear();
      ioFile.parsed = true;
      ioFile.bytes.clear();
      if (oValues) *oValues = ZEPAppSettingsValues();
      oFaults.push_back(ZEPAppFileError{ioFile.path, 0, 0, std::string("cannot be read: ") + ex.what(), true});
    }
    if (oFaults.empty()) return true;
    ioFile.fault = oFaults.front();
    // A faulty user's file contributes nothing rather than half of itself; the readable part of
    // an administrator's file keeps its locks.
    if (!iAdmin) {
      ioFile.doc = ZEPAppSettingsDoc();
      ioFile.layout.clear();
    }
    return false;
  }

  void LoadFile(File& ioFile, bool iAdmin) {
    if (ioFile.path.empty()) return;
    std::vector<ZEPAppFileError> faults;
    const bool read = ReadInto(ioFile, iAdmin, faults, iAdmin ? nullptr : &loaded);
    loadErrors.insert(loadErrors.end(), faults.begin(), faults.end());
    if (!read && !iAdmin) return;
    std::vector<ZEPAppFileError> found;
    if (ioFile.parsed) {
      found = CheckValues(ioFile, iAdmin, ioFile.doc);
    } else {
      found = CheckValues(ioFile, iAdmin, loaded);
      for (const auto& [kind, repo, attr] : ioFile.unusable) loaded.Of(kind)[repo].erase(attr);
    }
    auto& out = iAdmin ? loadErrors : loadWarnings; // the user's file: warnings, the default shows
    out.insert(out.end(), found.begin(), found.end());
  }

  // Puts the files' content for one repository into it.
  void Apply(ZEPAppRepoKind iKind, ZEPSysSettingRepository& ioRepo) {
    const RepoKey key{iKind, ioRepo.GetName()};
    baseline.erase(key); // what it is given is the user's document's usable values again
    // Given to an empty repository, the values are what it holds: from here on its writes tell
    // what changed. Merged into values it held, they are not.
    const bool holdsGiven = ioRepo.UserValues().empty();
    auto& staged = loaded.Of(iKind);
    auto it = staged.find(key.second);
    if (it != staged.end() && !handedOut.count(key)) { // from a quick load: moved, not copied
      ioRepo.SetUserValues(std::move(it->second));
      handedOut.insert(key);
    } else if (!quickLoad || it != staged.end()) { // else the file has nothing for it
      const auto& users = Doc(user).Of(iKind);
      if (auto repo = users.find(key.second); repo != users.end())
        for (const auto& [attr, entry] : repo->second) // in order: each insertion goes at the end
          if (entry.value && !Unusable(key, attr)) ioRepo.SetUserValue(attr, *entry.value);
    }
    ioRepo.ForgetWrites(holdsGiven);
    const auto& admins = admin.doc.Of(iKind);
    if (auto it = admins.find(ioRepo.GetName()); it != admins.end())
      for (const auto& [attr, entry] : it->second) {
        if (!admin.unusable.count({iKind, ioRepo.GetName(), attr})) ApplyAdmin(ioRepo, attr, entry);
        else if (entry.locked) ApplyAdmin(ioRepo, attr, ZEPAppAttrEntry{std::nullopt, true, entry.by});
      }
  }

  void ApplyAdmin(ZEPSysSettingRepository& ioRepo, const std::string& iAttr, const ZEPAppAttrEntry& iEntry) {
    if (iEntry.value) ioRepo.SetDefault(iAttr, *iEntry.value);
    ioRepo.SetLock(iAttr, iEntry.locked, iEntry.locked ? LockText(iEntry.by) : std::string());
  }

  ZEPSysSettingRepository* Bind(ZEPAppRepoKind iKind, const std::string& iName, bool iForceApply) {
    ZEPSysSettingRepository* repo = Find(iKind, iName);
    const bool fresh = repo == nullptr;
    if (fresh) {
      if (iKind == ZEPAppRepoKind::Setting) repo = ZEPSysSettingRepository::Open(iName);
      else repo = ZEPSysPreferenceRepository::Open(iName);
    }
    if (fresh || iForceApply) Apply(iKind, *repo);
    std::weak_ptr<Impl> self = weak_from_this();
    repo->SetSaveHandler([self, iKind](ZEPSysSettingRepository& r) -> long {
      std::shared_ptr<Impl> impl = self.lock();
      return impl ? impl->SaveUser(iKind, r) : E_FAIL;
    });
    bound.emplace(iKind, iName);
    return repo;
  }

  // Writes are refused while the administrator's file cannot be trusted.
  bool AdminTrusted() {
    if (!admin.fault) return true;
    Fail("nothing is written while the administrator's file cannot be read (" + admin.fault->Text() +
         "): its locks would not be sure to hold; have it corrected");
    return false;
  }

  // Locks the file, then reads it again: what other processes saved meanwhile is kept.
  bool LockAndReread(File& ioFile, bool iAdmin, ZEPAppFileLock& oLock) {
    std::string target, err;
    if (!ResolveLinks(ioFile.path, target, err) || !oLock.Acquire(target, lockTimeoutMs, err)) {
      Fail(err);
      return false;
    }
    RemoveStaleTemporaries(target);
    std::vector<ZEPAppFileError> faults;
    if (!ReadInto(ioFile, iAdmin, faults)) {
      Fail(ioFile.path + " is not changed because it could not be read (" + faults.front().Text() +
           "); correct or remove it");
      return false;
    }
    const std::vector<ZEPAppFileError> found = CheckValues(ioFile, iAdmin, Doc(ioFile));
    if (iAdmin && !found.empty()) {
      Fail(ioFile.path + " is not changed because it holds a fault (" + found.front().Text() + "); correct it first");
      return false;
    }
    return true;
  }

  // The save handler: the attributes of this repository changed by this run, written over what
  // the file holds now.
  long SaveUser(ZEPAppRepoKind iKind, ZEPSysSettingRepository& iRepo) {
    lastError.clear();
    if (user.path.empty())
      return Fail("the settings cannot be saved: no settings file is known (set HOME, XDG_CONFIG_HOME or " +
                  std::string(kSettingsFileEnv) + ")");
    if (user.fault)
      return Fail(user.path + " is not saved because it could not be read (" + user.fault->Text() +
                  "); correct or remove it");
    if (!AdminTrusted()) return E_FAIL;
    const RepoKey key{iKind, iRepo.GetName()};
    std::vector<Change> changes = ChangesOf(key, iRepo);
    if (user.fault) return Fail(user.path + " is not saved because it could not be read again (" +
                                user.fault->Text() + ")");
    if (changes.empty()) {
      if (iRepo.Written()) iRepo.ForgetWrites(); // written back as they were: nothing differs
      return S_OK;
    }

    // Should another process have written the file meanwhile, what the repository was given
    // is kept apart as its document is replaced: the changes stay what they are.
    ZEPAppFileLock lock;
    if (!LockAndReread(user, false, lock)) return E_FAIL;
    // The changes go into the file's content in place.
    auto& repos = user.doc.Of(iKind);
    auto repo = repos.find(iRepo.GetName());
    if (repo == repos.end()) repo = repos.emplace(iRepo.GetName(), ZEPAppRepoEntries()).first;
    ZEPAppRepoEntries& entries = repo->second;
    // Values replaced where they are can be rewritten in the text where they are; an attribute
    // added or removed moves everything after it.
    bool inPlace = true;
    std::vector<ZEPAppEntryRef> rewritten;
    rewritten.reserve(changes.size());
    ForEachPlace(entries, changes, [&](ZEPAppRepoEntries::iterator& ioAt, const Change& c) {
      const bool there = ioAt != entries.end() && ioAt->first == c.name;
      if (c.value) {
        if (!there) {
          ioAt = entries.emplace_hint(ioAt, c.name, ZEPAppAttrEntry());
          inPlace = false;
        }
        ioAt->second.value = *c.value; // a value of the same kind and count keeps its storage
        rewritten.push_back({iKind, repo->first, ioAt->first, ioAt->second});
        ++ioAt;
      } else if (there) {
        ioAt = entries.erase(ioAt);
        inPlace = false;
      }
    });
    if (entries.empty()) repos.erase(repo);
    if (long rc = WriteDoc(user, false, inPlace ? &rewritten : nullptr); FAILED(rc)) {
      // The file holds what it held: its document is read from those bytes again when needed.
      user.doc = ZEPAppSettingsDoc();
      user.layout.clear();
      user.parsed = false;
      return rc;
    }
    // What the repository was given becomes what it holds: the document says so now, a value
    // once left out included; a baseline kept apart follows the same changes.
    if (auto kept = baseline.find(key); kept != baseline.end()) {
      std::map<std::string, ZEPAppValue>& before = kept->second;
      ForEachPlace(before, changes, [&](std::map<std::string, ZEPAppValue>::iterator& ioAt, const Change& c) {
        const bool there = ioAt != before.end() && ioAt->first == c.name;
        if (c.value) {
          if (there) ioAt->second = *c.value;
          else ioAt = before.emplace_hint(ioAt, c.name, *c.value);
          ++ioAt;
        } else if (there) ioAt = before.erase(ioAt);
      });
    }
    if (!user.unusable.empty())
      for (const Change& c : changes) user.unusable.erase({iKind, iRepo.GetName(), c.name});
    erased[key].clear();
    if (iRepo.Written()) iRepo.ForgetWrites(); // it holds what it was given again
    return S_OK;
  }

  // One attribute a save changes: its new value, or null to remove it.
  struct Change {
    std::string name;
    const ZEPAppValue* value;
  };

  // What this run changed in a repository since it was given the file's values.
  std::vector<Change> ChangesOf(const RepoKey& iKey, const ZEPSysSettingRepository& iRepo) {
    const std::map<std::string, ZEPAppValue>& now = iRepo.UserValues();
    const std::set<std::string>& reset = erased[iKey];
    const std::vector<std::string>* written = iRepo.Written();
    if (auto kept = baseline.find(iKey); kept != baseline.end())
      return Changes(kept->second, [](const auto& e) { return &e.second; }, now, reset, written);
    static const ZEPAppRepoEntries kNothing;
    const auto& repos = Doc(user).Of(iKey.first);
    auto repo = repos.find(iKey.second);
    return Changes(repo == repos.end() ? kNothing : repo->second,
                   [&](const auto& e) { return e.second.value && !Unusable(iKey, e.first) ? &*e.second.value : nullptr; },
                   now, reset, written);
  }

  // What differs between what the repository was given (the elements of iBefore that iGiven
  // answers a value for) and what it holds now, and what was reset since, in name order. One
  // pass over both (they are ordered alike), or, when iWritten lists every name written since
  // the repository held what it was given, a look at those names only.
  template <class Before, class Given>
  static std::vector<Change> Changes(const Before& iBefore, Given iGiven, const std::map<std::string, ZEPAppValue>& iNow,
                                     const std::set<std::string>& iErased, const std::vector<std::string>* iWritten) {
    std::vector<Change> changes;
    if (iWritten) {
      std::vector<std::string> names(*iWritten);
      names.insert(names.end(), iErased.begin(), iErased.end());
      std::sort(names.begin(), names.end());
      names.erase(std::unique(names.begin(), names.end()), names.end());
      for (const std::string& name : names) {
        auto b = iBefore.find(name);
        const ZEPAppValue* given = b == iBefore.end() ? nullptr : iGiven(*b);
        auto n = iNow.find(name);
        if (n != iNow.end() ? !given || !(*given == n->second) : given || iErased.count(name))
          changes.push_back({name, n == iNow.end() ? nullptr : &n->second});
      }
      return changes;
    }
    auto b = iBefore.begin();
    auto n = iNow.begin();
    for (;;) {
      while (b != iBefore.end() && !iGiven(*b)) ++b;
      if (b == iBefore.end() && n == iNow.end()) break;
      const int order = b == iBefore.end() ? 1 : n == iNow.end() ? -1 : b->first.compare(n->first);
      if (order > 0) { // new since
        changes.push_back({n->first, &n->second});
        ++n;
      } else if (order < 0) { // gone since
        changes.push_back({b->first, nullptr});
        ++b;
      } else {
        if (!(*iGiven(*b) == n->second)) changes.push_back({n->first, &n->second});
        ++b;
        ++n;
      }
    }
    bool added = false;
    for (const std::string& attr : iErased) {
      auto given = iBefore.find(attr);
      if (!iNow.count(attr) && (given == iBefore.end() || !iGiven(*given))) {
        changes.push_back({attr, nullptr});
        added = true;
      }
    }
    if (added)
      std::sort(changes.begin(), changes.end(), [](const Change& x, const Change& y) { return x.name < y.name; });
    return changes;
  }

  // Calls iVisit(at, change) for each change in order, at the first element of ioMap not
  // before the change's name: a search each for a few changes, one walk for many.
  template <class Map, class Visit>
  static void ForEachPlace(Map& ioMap, const std::vector<Change>& iChanges, Visit iVisit) {
    const bool walk = iChanges.size() * 16 > ioMap.size();
    auto at = ioMap.begin();
    for (const Change& c : iChanges) {
      if (walk)
        while (at != ioMap.end() && at->first < c.name) ++at;
      else at = ioMap.lower_bound(c.name);
      iVisit(at, c);
    }
  }

  // Writes what ioFile.doc holds. iChanged: when only those entries changed, and in place,
  // since ioFile.bytes were written from the document, only they are written again in the text.
  long WriteDoc(File& ioFile, bool iAdmin, const std::vector<ZEPAppEntryRef>* iChanged = nullptr) {
    std::string text, err;
    // Moved to where the entries lie in text; given up should the write fail.
    if (!(iChanged && !ioFile.layout.empty() && ioFile.onDisk &&
          UpdateSettingsText(ioFile.bytes, ioFile.layout, *iChanged, iAdmin, text)) &&
        !FormatSettingsText(ioFile.doc, iAdmin, text, err, &ioFile.layout)) {
      ioFile.layout.clear();
      return Fail(ioFile.path + ": " + err);
    }
    if (!(ioFile.onDisk && text == ioFile.bytes)) {
      if (FAILED(WriteFileAtomically(*ops, ioFile.path, text, err))) {
        ioFile.layout.clear();
        return Fail(err);
      }
      ioFile.bytes = std::move(text);
      ioFile.onDisk = true;
      if (&ioFile == &user) quickLoad = false;
    }
    return S_OK;
  }

  long Write(File& ioFile, ZEPAppSettingsDoc&& iNext, bool iAdmin) {
    std::swap(ioFile.doc, iNext);
    const long rc = WriteDoc(ioFile, iAdmin);
    if (FAILED(rc)) std::swap(ioFile.doc, iNext);
    return rc;
  }

  // What one edit does to its entry: S_OK when it changes it, 1 when there is nothing to do.
  long Edit(const ZEPAppAdminEdit& iEdit, ZEPAppAttrEntry& ioEntry, const ZEPSysSettingRepository& iRepo,
            const std::string& iWho) {
    switch (iEdit.action) {
    case ZEPAppAdminAction::Lock:
      if (iEdit.value) ioEntry.value = *iEdit.value;
      else if (const ZEPAppValue* now = iRepo.Effective(iEdit.attribute)) ioEntry.value = *now;
      ioEntry.locked = true;
      ioEntry.by = iWho;
      return S_OK;
    case ZEPAppAdminAction::Unlock: // whether it is locked is decided on the file as read under its lock
      if (!ioEntry.locked) return 1;
      ioEntry.locked = false;
      ioEntry.by.clear();
      return S_OK;
    case ZEPAppAdminAction::Default:
      ioEntry.value = *iEdit.value;
      return S_OK;
    case ZEPAppAdminAction::RemoveDefault:
      if (ioEntry.locked)
        return Fail(iEdit.attribute + " is locked: unlock it first (its value then stays as a default)");
      if (!ioEntry.value) return 1;
      ioEntry.value.reset();
      return S_OK;
    }
    return Fail("unknown change of the administrator's file");
  }

  // Changes entries of the administrator's file, writes it once, then shows them in the
  // repositories. Nothing is written unless every edit can be made.
  long EditAdmin(const std::vector<ZEPAppAdminEdit>& iEdits) {
    lastError.clear();
    for (const ZEPAppAdminEdit& e : iEdits) {
      if (e.repository.empty() || e.attribute.empty()) return Fail("a repository and an attribute name are needed");
      if (e.action == ZEPAppAdminAction::Default && !e.value) return Fail(e.attribute + ": a default needs a value");
      if (e.value && !IsFinite(*e.value)) return Fail(e.attribute + ": NaN and infinities cannot be stored");
      if (std::string why = e.value ? Unstorable(*e.value) : std::string(); !why.empty())
        return Fail(e.attribute + ": " + why);
    }
    if (admin.path.empty())
      return Fail("no administrator's file: give --admin FILE or set " + std::string(kAdminFileEnv));
    if (admin.fault)
      return Fail(admin.path + " is not changed because it could not be read (" + admin.fault->Text() +
                  "); correct it first");
    std::vector<ZEPSysSettingRepository*> repos;
    for (const ZEPAppAdminEdit& e : iEdits) repos.push_back(Bind(e.kind, e.repository, false));
    ZEPAppFileLock lock;
    if (!LockAndReread(admin, true, lock)) return E_FAIL;
    const std::string who = CurrentUserName();
    ZEPAppSettingsDoc next = admin.doc;
    std::vector<std::pair<std::size_t, ZEPAppAttrEntry>> applied;
    for (std::size_t i = 0; i < iEdits.size(); ++i) {
      const ZEPAppAdminEdit& e = iEdits[i];
      ZEPAppRepoEntries& entries = next.Of(e.kind)[e.repository];
      ZEPAppAttrEntry& entry = entries[e.attribute];
      const long rc = Edit(e, entry, *repos[i], who);
      if (FAILED(rc)) return rc;
      if (rc == S_OK && entry.value) {
        auto rule = rules.find({e.kind, e.repository, e.attribute});
        std::string why = rule == rules.end() ? std::string() : Verdict(rule->second, *entry.value);
        if (!why.empty())
          return Fail(std::string(SectionName(e.kind)) + "/" + e.repository + "/" + e.attribute + ": " + why);
      }
      if (rc == S_OK) applied.emplace_back(i, entry);
      if (EntryEmpty(entry)) entries.erase(e.attribute);
      if (entries.empty()) next.Of(e.kind).erase(e.repository);
    }
    if (applied.empty()) return 1;
    if (long rc = Write(admin, std::move(next), true); FAILED(rc)) return rc;
    for (const auto& [i, entry] : applied) ApplyAdmin(*repos[i], iEdits[i].attribute, entry);
    return S_OK;
  }

  long Save(ZEPAppRepoKind iKind, ZEPSysSettingRepository& ioRepo) {
    lastError.clear();
    // A reset of a value the file holds but the repository never took changes only the file.
    const bool pending = !erased[{iKind, ioRepo.GetName()}].empty();
    long rc = pending ? SaveUser(iKind, ioRepo) : ioRepo.SaveRepository();
    if (pending && SUCCEEDED(rc)) rc = ioRepo.SaveRepository();
    if (FAILED(rc) && lastError.empty()) lastError = ioRepo.GetName() + ": the save failed";
    return rc;
  }

  // Marks the user's entries of an attribute for removal at the next save.
  void Erase(ZEPAppRepoKind iKind, const std::string& iRepo, const std::string& iAttr) {
    const auto& repos = Doc(user).Of(iKind);
    auto it = repos.find(iRepo);
    if (it != repos.end() && it->second.count(iAttr)) erased[{iKind, iRepo}].insert(iAttr);
  }

  long ResetRepository(ZEPAppRepoKind iKind, const std::string& iRepo) {
    ZEPSysSettingRepository* repo = Bind(iKind, iRepo, false);
    std::set<std::string> names;
    for (const auto& [attr, value] : repo->UserValues()) names.insert(attr);
    const auto& repos = Doc(user).Of(iKind);
    if (auto it = repos.find(iRepo); it != repos.end())
      for (const auto& [attr, entry] : it->second) names.insert(attr);
    for (const std::string& attr : names) {
      if (repo->IsLocked(attr)) continue;
      repo->ResetAttr(attr);
      Erase(iKind, iRepo, attr);
    }
    return Save(iKind, *repo);
  }
};

ZEPAppSettingsFile::ZEPAppSettingsFile(std::shared_ptr<ZEPAppFileOps> iOps) : _pImpl(std::make_shared<Impl>()) {
  _pImpl->ops = iOps ? std::move(iOps) : std::make_shared<ZEPAppPosixFileOps>();
}

ZEPAppSettingsFile::~ZEPAppSettingsFile() = default;

void ZEPAppSettingsFile::SetRules(std::vector<ZEPAppAttrRule> iRules) {
  Impl& d = *_pImpl;
  d.rules.clear();
  d.ruled.clear();
  for (ZEPAppAttrRule& r : iRules) {
    d.ruled.emplace(r.kind, r.repository);
    Impl::AttrKey key{r.kind, r.repository, r.attribute};
    d.rules.emplace(std::move(key), std::move(r));
  }
}

void ZEPAppSettingsFile::SetLockTimeout(int iMilliseconds) { _pImpl->lockTimeoutMs = iMilliseconds; }

long ZEPAppSettingsFile::Load(const std::string& iUserPath, const std::string& iAdminPath) {
  Impl& d = *_pImpl;
  d.lastError.clear();
  d.loadErrors.clear();
  d.loadWarnings.clear();
  d.erased.clear();
  d.baseline.clear();
  d.loaded = ZEPAppSettingsValues();
  d.handedOut.clear();
  d.quickLoad = false;
  d.user = Impl::File();
  d.user.path = iUserPath;
  d.admin = Impl::File();
  d.admin.path = iAdminPath;
  std::error_code ec;
  d.adminWhere = iAdminPath.empty() ? "" : fs::absolute(iAdminPath, ec).lexically_normal().string();
  if (d.adminWhere.empty()) d.adminWhere = iAdminPath;
  d.LoadFile(d.admin, true);
  d.LoadFile(d.user, false);

  std::set<Impl::RepoKey> names = d.bound;
  for (ZEPAppRepoKind kind : {ZEPAppRepoKind::Setting, ZEPAppRepoKind::Preference})
  {
    for (const auto& repo : d.admin.doc.Of(kind)) names.emplace(kind, repo.first);
    if (d.user.parsed)
      for (const auto& repo : d.user.doc.Of(kind)) names.emplace(kind, repo.first);
    else
      for (const auto& repo : d.loaded.Of(kind)) names.emplace(kind, repo.first);
  }
  for (const auto& [kind, name] : names) d.Bind(kind, name, true);
  if (d.loadErrors.empty()) return S_OK;
  d.lastError = d.loadErrors.front().Text();
  return E_FAIL;
}

const std::vector<ZEPAppFileError>& ZEPAppSettingsFile::LoadErrors() const { return _pImpl->loadErrors; }
const std::vector<ZEPAppFileError>& ZEPAppSettingsFile::LoadWarnings() const { return _pImpl->loadWarnings; }
const ZEPAppFileError* ZEPAppSettingsFile::AdminFault() const {
  return _pImpl->admin.fault ? &*_pImpl->admin.fault : nullptr;
}

ZEPSysSettingRepository* ZEPAppSettingsFile::OpenSettings(const std::string& iName) {
  return _pImpl->Bind(ZEPAppRepoKind::Setting, iName, false);
}

ZEPSysPreferenceRepository* ZEPAppSettingsFile::OpenPreferences(const std::string& iName) {
  return static_cast<ZEPSysPreferenceRepository*>(_pImpl->Bind(ZEPAppRepoKind::Preference, iName, false));
}

long ZEPAppSettingsFile::SaveAll() {
  Impl& d = *_pImpl;
  long result = S_OK;
  std::string firstError;
  for (const auto& [kind, name] : d.bound) {
    ZEPSysSettingRepository* repo = Find(kind, name);
    if (!repo) continue;
    long rc = d.Save(kind, *repo);
    if (FAILED(rc) && SUCCEEDED(result)) {
      result = rc;
      firstError = d.lastError;
    }
  }
  d.lastError = firstError;
  return result;
}

long ZEPAppSettingsFile::Lock(const std::string& iRepository, const std::string& iAttribute, ZEPAppRepoKind iKind) {
  return Administer({{ZEPAppAdminAction::Lock, iRepository, iAttribute, std::nullopt, iKind}});
}

long ZEPAppSettingsFile::Lock(const std::string& iRepository, const std::string& iAttribute, const ZEPAppValue& iValue,
                              ZEPAppRepoKind iKind) {
  return Administer({{ZEPAppAdminAction::Lock, iRepository, iAttribute, iValue, iKind}});
}

long ZEPAppSettingsFile::Unlock(const std::string& iRepository, const std::string& iAttribute, ZEPAppRepoKind iKind) {
  return Administer({{ZEPAppAdminAction::Unlock, iRepository, iAttribute, std::nullopt, iKind}});
}

long ZEPAppSettingsFile::SetAdminDefault(const std::string& iRepository, const std::string& iAttribute,
                                         const ZEPAppValue& iValue, ZEPAppRepoKind iKind) {
  return Administer({{ZEPAppAdminAction::Default, iRepository, iAttribute, iValue, iKind}});
}

long ZEPAppSettingsFile::RemoveAdminDefault(const std::string& iRepository, const std::string& iAttribute,
                                            ZEPAppRepoKind iKind) {
  return Administer({{ZEPAppAdminAction::RemoveDefault, iRepository, iAttribute, std::nullopt, iKind}});
}

long ZEPAppSettingsFile::Administer(const std::vector<ZEPAppAdminEdit>& iEdits) { return _pImpl->EditAdmin(iEdits); }

const ZEPAppSettingsDoc& ZEPAppSettingsFile::AdminDoc() const { return _pImpl->admin.doc; }

long ZEPAppSettingsFile::Reset(const std::string& iRepository, const std::string& iAttribute, ZEPAppRepoKind iKind) {
  Impl& d = *_pImpl;
  d.lastError.clear();
  ZEPSysSettingRepository* repo = d.Bind(iKind, iRepository, false);
  if (repo->IsLocked(iAttribute)) {
    ZEPSettingInfo info;
    repo->GetLockInfo(iAttribute, info);
    return d.Fail(std::string(SectionName(iKind)) + "/" + iRepository + "/" + iAttribute +
                  " cannot be reset: " + info.GetLockText());
  }
  repo->ResetAttr(iAttribute);
  d.Erase(iKind, iRepository, iAttribute);
  return d.Save(iKind, *repo);
}

long ZEPAppSettingsFile::ResetAll(const std::string& iRepository, ZEPAppRepoKind iKind) {
  _pImpl->lastError.clear();
  return _pImpl->ResetRepository(iKind, iRepository);
}

long ZEPAppSettingsFile::ResetAll() {
  Impl& d = *_pImpl;
  std::set<Impl::RepoKey> names = d.bound;
  for (ZEPAppRepoKind kind : {ZEPAppRepoKind::Setting, ZEPAppRepoKind::Preference})
    for (const auto& repo : d.Doc(d.user).Of(kind)) names.emplace(kind, repo.first);
  long result = S_OK;
  std::string firstError;
  for (const auto& [kind, name] : names) {
    long rc = d.ResetRepository(kind, name);
    if (FAILED(rc) && SUCCEEDED(result)) {
      result = rc;
      firstError = d.lastError;
    }
  }
  d.lastError = firstError;
  return result;
}

const std::string& ZEPAppSettingsFile::LastError() const { return _pImpl->lastError; }
const std::string& ZEPAppSettingsFile::UserPath() const { return _pImpl->user.path; }
const std::string& ZEPAppSettingsFile::AdminPath() const { return _pImpl->admin.path; }
std::string ZEPAppSettingsFile::LockText(const std::string& iWho) const { return _pImpl->LockText(iWho); }

} // namespace zepapp
