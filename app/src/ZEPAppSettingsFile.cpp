#include "ZEPAppSettingsFile.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iterator>
#include <optional>
#include <set>
#include <system_error>
#include <utility>

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

// The file's bytes; a missing file is no error (first run) and answers oExists false.
bool ReadWholeFile(const std::string& iPath, std::string& oText, bool& oExists, ZEPAppFileError& oError) {
  oText.clear();
  oExists = false;
  oError = ZEPAppFileError{iPath, 0, 0, ""};
  std::error_code ec;
  fs::file_status st = fs::status(iPath, ec);
  if (st.type() == fs::file_type::not_found) return true;
  if (ec) {
    oError.message = "cannot read: " + ec.message();
    return false;
  }
  oExists = true;
  if (st.type() == fs::file_type::directory) {
    oError.message = "is a folder, expected a settings file";
    return false;
  }
  std::uintmax_t size = fs::file_size(iPath, ec);
  if (!ec && size > kMaxFileSize) {
    oError.message = "is " + std::to_string(size) + " bytes long, too large for a settings file";
    return false;
  }
  std::ifstream in(iPath, std::ios::binary);
  if (!in) {
    oError.message = std::string("cannot open: ") + std::strerror(errno ? errno : EIO);
    return false;
  }
  oText.assign(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
  if (in.bad()) {
    oError.message = "cannot read: input error";
    return false;
  }
  return true;
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
  // One settings file as last read or written.
  struct File {
    std::string path;
    ZEPAppSettingsDoc doc;
    std::string bytes;  // what the file holds, to skip writes that change nothing
    bool onDisk = false;
    std::optional<ZEPAppFileError> fault; // set when it could not be read: never written then
  };

  std::shared_ptr<ZEPAppFileOps> ops;
  File user, admin;
  std::string adminWhere; // absolute path shown in lock texts
  std::vector<ZEPAppFileError> loadErrors;
  std::string lastError;
  std::set<std::pair<ZEPAppRepoKind, std::string>> bound;

  long Fail(std::string iWhy) {
    lastError = std::move(iWhy);
    return E_FAIL;
  }

  std::string LockText(const std::string& iWho) const {
    return "Locked by " + (iWho.empty() ? std::string("an administrator") : iWho) + " in " + adminWhere;
  }

  void LoadFile(File& ioFile, bool iAdmin) {
    if (ioFile.path.empty()) return;
    try {
      ZEPAppFileError err;
      if (!ReadWholeFile(ioFile.path, ioFile.bytes, ioFile.onDisk, err)) {
        ioFile.fault = err;
        loadErrors.push_back(err);
        return;
      }
      std::vector<ZEPAppFileError> faults = ParseSettingsText(ioFile.bytes, ioFile.path, iAdmin, ioFile.doc);
      if (!faults.empty()) {
        ioFile.fault = faults.front();
        loadErrors.insert(loadErrors.end(), faults.begin(), faults.end());
      }
    } catch (const std::exception& ex) { // out of memory and the like: still a report, not a crash
      ioFile.fault = ZEPAppFileError{ioFile.path, 0, 0, std::string("cannot be read: ") + ex.what()};
      loadErrors.push_back(*ioFile.fault);
    }
    // A faulty file contributes nothing rather than half of itself.
    if (ioFile.fault) ioFile.doc = ZEPAppSettingsDoc();
  }

  // Puts the files' content for one repository into it.
  void Apply(ZEPAppRepoKind iKind, ZEPSysSettingRepository& ioRepo) {
    const auto& users = user.doc.Of(iKind);
    if (auto it = users.find(ioRepo.GetName()); it != users.end())
      for (const auto& [attr, entry] : it->second)
        if (entry.value) ioRepo.SetUserValue(attr, *entry.value);
    const auto& admins = admin.doc.Of(iKind);
    if (auto it = admins.find(ioRepo.GetName()); it != admins.end())
      for (const auto& [attr, entry] : it->second) ApplyAdmin(ioRepo, attr, entry);
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

  // The save handler: this repository's values as they are now, the others as last saved.
  long SaveUser(ZEPAppRepoKind iKind, const ZEPSysSettingRepository& iRepo) {
    lastError.clear();
    if (user.path.empty())
      return Fail("the settings cannot be saved: no settings file is known (set HOME, XDG_CONFIG_HOME or " +
                  std::string(kSettingsFileEnv) + ")");
    if (user.fault)
      return Fail(user.path + " is not saved because it could not be read (" + user.fault->Text() +
                  "); correct or remove it");
    ZEPAppSettingsDoc next = user.doc;
    ZEPAppRepoEntries entries;
    for (const auto& [attr, value] : iRepo.UserValues()) entries[attr].value = value;
    if (entries.empty()) next.Of(iKind).erase(iRepo.GetName());
    else next.Of(iKind)[iRepo.GetName()] = std::move(entries);
    return Write(user, std::move(next), false);
  }

  long Write(File& ioFile, ZEPAppSettingsDoc&& iNext, bool iAdmin) {
    std::string text, err;
    if (!FormatSettingsText(iNext, iAdmin, text, err)) return Fail(ioFile.path + ": " + err);
    if (!(ioFile.onDisk && text == ioFile.bytes)) {
      if (FAILED(WriteFileAtomically(*ops, ioFile.path, text, err))) return Fail(err);
      ioFile.bytes = std::move(text);
      ioFile.onDisk = true;
    }
    ioFile.doc = std::move(iNext);
    return S_OK;
  }

  // Changes one entry of the administrator's file, writes it, then shows it in the repository.
  template <class Edit>
  long EditAdmin(ZEPAppRepoKind iKind, const std::string& iRepo, const std::string& iAttr, Edit iEdit) {
    lastError.clear();
    if (iRepo.empty() || iAttr.empty()) return Fail("a repository and an attribute name are needed");
    if (admin.path.empty())
      return Fail("no administrator's file: give --admin FILE or set " + std::string(kAdminFileEnv));
    if (admin.fault)
      return Fail(admin.path + " is not changed because it could not be read (" + admin.fault->Text() +
                  "); correct it first");
    ZEPSysSettingRepository* repo = Bind(iKind, iRepo, false);
    ZEPAppSettingsDoc next = admin.doc;
    ZEPAppAttrEntry& entry = next.Of(iKind)[iRepo][iAttr];
    iEdit(entry, *repo);
    const ZEPAppAttrEntry applied = entry;
    if (EntryEmpty(entry)) next.Of(iKind)[iRepo].erase(iAttr);
    if (next.Of(iKind)[iRepo].empty()) next.Of(iKind).erase(iRepo);
    if (long rc = Write(admin, std::move(next), true); FAILED(rc)) return rc;
    ApplyAdmin(*repo, iAttr, applied);
    return S_OK;
  }

  long Save(ZEPSysSettingRepository& ioRepo) {
    lastError.clear();
    long rc = ioRepo.SaveRepository();
    if (FAILED(rc) && lastError.empty()) lastError = ioRepo.GetName() + ": the save failed";
    return rc;
  }

  long ResetRepository(ZEPAppRepoKind iKind, const std::string& iRepo) {
    ZEPSysSettingRepository* repo = Bind(iKind, iRepo, false);
    std::vector<std::string> names;
    for (const auto& [attr, value] : repo->UserValues())
      if (!repo->IsLocked(attr)) names.push_back(attr);
    for (const std::string& attr : names) repo->ResetAttr(attr);
    return Save(*repo);
  }
};

ZEPAppSettingsFile::ZEPAppSettingsFile(std::shared_ptr<ZEPAppFileOps> iOps) : _pImpl(std::make_shared<Impl>()) {
  _pImpl->ops = iOps ? std::move(iOps) : std::make_shared<ZEPAppPosixFileOps>();
}

ZEPAppSettingsFile::~ZEPAppSettingsFile() = default;

long ZEPAppSettingsFile::Load(const std::string& iUserPath, const std::string& iAdminPath) {
  Impl& d = *_pImpl;
  d.lastError.clear();
  d.loadErrors.clear();
  d.user = Impl::File{iUserPath, {}, {}, false, std::nullopt};
  d.admin = Impl::File{iAdminPath, {}, {}, false, std::nullopt};
  std::error_code ec;
  d.adminWhere = iAdminPath.empty() ? "" : fs::absolute(iAdminPath, ec).lexically_normal().string();
  if (d.adminWhere.empty()) d.adminWhere = iAdminPath;
  d.LoadFile(d.admin, true);
  d.LoadFile(d.user, false);

  std::set<std::pair<ZEPAppRepoKind, std::string>> names = d.bound;
  for (ZEPAppRepoKind kind : {ZEPAppRepoKind::Setting, ZEPAppRepoKind::Preference})
    for (const Impl::File* f : {&d.admin, &d.user})
      for (const auto& repo : f->doc.Of(kind)) names.emplace(kind, repo.first);
  for (const auto& [kind, name] : names) d.Bind(kind, name, true);
  if (d.loadErrors.empty()) return S_OK;
  d.lastError = d.loadErrors.front().Text();
  return E_FAIL;
}

const std::vector<ZEPAppFileError>& ZEPAppSettingsFile::LoadErrors() const { return _pImpl->loadErrors; }

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
    long rc = d.Save(*repo);
    if (FAILED(rc) && SUCCEEDED(result)) {
      result = rc;
      firstError = d.lastError;
    }
  }
  d.lastError = firstError;
  return result;
}

long ZEPAppSettingsFile::Lock(const std::string& iRepository, const std::string& iAttribute, ZEPAppRepoKind iKind) {
  const std::string who = CurrentUserName();
  return _pImpl->EditAdmin(iKind, iRepository, iAttribute, [&](ZEPAppAttrEntry& e, ZEPSysSettingRepository& r) {
    if (const ZEPAppValue* now = r.Effective(iAttribute)) e.value = *now;
    e.locked = true;
    e.by = who;
  });
}

long ZEPAppSettingsFile::Lock(const std::string& iRepository, const std::string& iAttribute, const ZEPAppValue& iValue,
                              ZEPAppRepoKind iKind) {
  if (!IsFinite(iValue)) return _pImpl->Fail(iAttribute + ": NaN and infinities cannot be stored");
  const std::string who = CurrentUserName();
  return _pImpl->EditAdmin(iKind, iRepository, iAttribute, [&](ZEPAppAttrEntry& e, ZEPSysSettingRepository&) {
    e.value = iValue;
    e.locked = true;
    e.by = who;
  });
}

long ZEPAppSettingsFile::Unlock(const std::string& iRepository, const std::string& iAttribute, ZEPAppRepoKind iKind) {
  Impl& d = *_pImpl;
  const auto& repos = d.admin.doc.Of(iKind);
  auto repo = repos.find(iRepository);
  bool locked = repo != repos.end() && repo->second.count(iAttribute) && repo->second.at(iAttribute).locked;
  if (!locked && !d.admin.path.empty() && !d.admin.fault) {
    d.lastError.clear();
    return 1;
  }
  return d.EditAdmin(iKind, iRepository, iAttribute, [](ZEPAppAttrEntry& e, ZEPSysSettingRepository&) {
    e.locked = false;
    e.by.clear();
  });
}

long ZEPAppSettingsFile::SetAdminDefault(const std::string& iRepository, const std::string& iAttribute,
                                         const ZEPAppValue& iValue, ZEPAppRepoKind iKind) {
  if (!IsFinite(iValue)) return _pImpl->Fail(iAttribute + ": NaN and infinities cannot be stored");
  return _pImpl->EditAdmin(iKind, iRepository, iAttribute,
                           [&](ZEPAppAttrEntry& e, ZEPSysSettingRepository&) { e.value = iValue; });
}

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
  return d.Save(*repo);
}

long ZEPAppSettingsFile::ResetAll(const std::string& iRepository, ZEPAppRepoKind iKind) {
  _pImpl->lastError.clear();
  return _pImpl->ResetRepository(iKind, iRepository);
}

long ZEPAppSettingsFile::ResetAll() {
  Impl& d = *_pImpl;
  std::set<std::pair<ZEPAppRepoKind, std::string>> names = d.bound;
  for (ZEPAppRepoKind kind : {ZEPAppRepoKind::Setting, ZEPAppRepoKind::Preference})
    for (const auto& repo : d.user.doc.Of(kind)) names.emplace(kind, repo.first);
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
