#include "ZEPSettings.h"

#include <algorithm>
#include <cmath>
#include <type_traits>

ZEP_IMPLEMENT_CLASS(ZEPDlgLock, ZEPDialog)

// ---- padlock --------------------------------------------------------------------------------
ZEPDlgLock::ZEPDlgLock(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo, unsigned long iStyle)
    : ZEPDialog(iParent, iName, iStyle), _info(iInfo) {
  SetIconName(_info.IsLocked() ? "I_Locked" : "I_Unlocked");
}

ZEPDlgLock::~ZEPDlgLock() {
  for (ZEPDialog* d : _associated) d->_pGoverningLock = nullptr;
}

void ZEPDlgLock::AddAssociatedDialog(ZEPDialog* iDialog) {
  if (!iDialog || iDialog == this) return;
  if (iDialog->_pGoverningLock && iDialog->_pGoverningLock != this)
    iDialog->_pGoverningLock->RemoveAssociatedDialog(iDialog);
  if (std::find(_associated.begin(), _associated.end(), iDialog) == _associated.end()) _associated.push_back(iDialog);
  iDialog->_pGoverningLock = this;
  if (IsLocked()) iDialog->SetSensitivity(ZEPDlgDisable);
}

void ZEPDlgLock::RemoveAssociatedDialog(ZEPDialog* iDialog) {
  _associated.erase(std::remove(_associated.begin(), _associated.end(), iDialog), _associated.end());
  if (iDialog && iDialog->_pGoverningLock == this) iDialog->_pGoverningLock = nullptr;
}

long ZEPDlgLock::GetAssociatedDialogSensitivity(unsigned long& oSensitivity) const {
  oSensitivity = IsLocked() ? ZEPDlgDisable : ZEPDlgEnable;
  return S_OK;
}

void ZEPDlgLock::SetLocked(bool iLocked) {
  _info.SetLocked(iLocked);
  SetIconName(iLocked ? "I_Locked" : "I_Unlocked");
  for (ZEPDialog* d : _associated) d->SetSensitivity(iLocked ? ZEPDlgDisable : ZEPDlgEnable);
}

void ZEPDlgLock::DumpState(std::string& ioOut) const {
  if (!IsLocked()) {
    ioOut += " open";
    return;
  }
  ioOut += " LOCKED";
  if (!_info.GetLockText().empty()) ioOut += " (" + _info.GetLockText() + ")";
}

// ---- repositories ---------------------------------------------------------------------------
namespace {
template <class R> std::map<std::string, std::unique_ptr<R>>& Registry() {
  static std::map<std::string, std::unique_ptr<R>> registry;
  return registry;
}

// The registries of setting and preference repositories work alike.
template <class R> R* Lookup(const char* iName) {
  if (!iName) return nullptr;
  auto& reg = Registry<R>();
  auto it = reg.find(iName);
  return it == reg.end() ? nullptr : it->second.get();
}

template <class R> R* OpenIn(const std::string& iName) {
  auto& slot = Registry<R>()[iName];
  if (!slot) slot = std::make_unique<R>(iName);
  return slot.get();
}

// What a repository can keep of a text: UTF-8 without NUL bytes (the files hold JSON strings).
bool IsStorableText(const std::string& iText) {
  return iText.find('\0') == std::string::npos && ZEPFirstBadUtf8(iText) == std::string::npos;
}

template <class T> std::vector<T> const* As(const ZEPSysSettingRepository::Value* v) {
  return v ? std::get_if<std::vector<T>>(v) : nullptr;
}
} // namespace

ZEPSysSettingRepository* ZEPSysSettingRepository::GetRepository(const char* iName, int) {
  return Lookup<ZEPSysSettingRepository>(iName);
}

ZEPSysSettingRepository* ZEPSysSettingRepository::Open(const std::string& iName) {
  return OpenIn<ZEPSysSettingRepository>(iName);
}

void ZEPSysSettingRepository::Close(const std::string& iName) { Registry<ZEPSysSettingRepository>().erase(iName); }
void ZEPSysSettingRepository::CloseAll() { Registry<ZEPSysSettingRepository>().clear(); }

const ZEPSysSettingRepository::Value* ZEPSysSettingRepository::Effective(const std::string& iName) const {
  auto d = _defaults.find(iName);
  if (IsLocked(iName)) return d == _defaults.end() ? nullptr : &d->second;
  auto u = _user.find(iName);
  if (u != _user.end()) return &u->second;
  return d == _defaults.end() ? nullptr : &d->second;
}

template <class T> int ZEPSysSettingRepository::Read(const char* iName, T* oValues, int iCount) const {
  if (!iName || !oValues || iCount <= 0) return 0;
  const std::vector<T>* stored = As<T>(Effective(iName));
  if (!stored) return 0;
  int n = std::min(iCount, static_cast<int>(stored->size()));
  std::copy(stored->begin(), stored->begin() + n, oValues);
  return n;
}

template <class T> int ZEPSysSettingRepository::Write(const char* iName, const T* iValues, int iCount) {
  if (!iName || !*iName || !iValues || iCount <= 0 || IsLocked(iName)) return 0;
  if constexpr (std::is_floating_point_v<T>) {
    for (int i = 0; i < iCount; ++i)
      if (!std::isfinite(iValues[i])) return 0; // no NaN or infinity ever reaches a store
  }
  return Store(iName, std::vector<T>(iValues, iValues + iCount));
}

template <class T> int ZEPSysSettingRepository::Store(const char* iName, std::vector<T>&& values) {
  auto it = _user.lower_bound(iName);
  if (it != _user.end() && it->first == iName) {
    std::vector<T>* old = std::get_if<std::vector<T>>(&it->second);
    if (old && *old == values) return 1;
    if (old) old->swap(values);
    else it->second = std::move(values);
  } else {
    _user.emplace_hint(it, iName, std::move(values));
  }
  _modified = true;
  NoteWrite(iName);
  return 1;
}

void ZEPSysSettingRepository::NoteWrite(const char* iName) {
  // Past a few dozen names, comparing every value is as quick as looking each one up.
  constexpr std::size_t kKept = 64;
  if (!_writtenKnown) return;
  if (_written.size() < kKept) _written.emplace_back(iName);
  else {
    _written.clear();
    _writtenKnown = false;
  }
}

int ZEPSysSettingRepository::ReadAttr(const char* n, double* v, int c) const { return Read(n, v, c); }
int ZEPSysSettingRepository::ReadAttr(const char* n, int* v, int c) const { return Read(n, v, c); }
int ZEPSysSettingRepository::ReadAttr(const char* n, unsigned int* v, int c) const { return Read(n, v, c); }
int ZEPSysSettingRepository::WriteAttr(const char* n, const double* v, int c) { return Write(n, v, c); }
int ZEPSysSettingRepository::WriteAttr(const char* n, const int* v, int c) { return Write(n, v, c); }
int ZEPSysSettingRepository::WriteAttr(const char* n, const unsigned int* v, int c) { return Write(n, v, c); }

int ZEPSysSettingRepository::ReadAttr(const char* iName, std::vector<std::string>& oTexts) const {
  const std::vector<std::string>* stored = iName ? As<std::string>(Effective(iName)) : nullptr;
  if (!stored) return -1;
  oTexts = *stored;
  return static_cast<int>(stored->size());
}

int ZEPSysSettingRepository::WriteAttr(const char* iName, const std::vector<std::string>& iTexts) {
  if (!iName || !*iName || IsLocked(iName)) return 0;
  for (const std::string& text : iTexts)
    if (!IsStorableText(text)) return 0;
  return Store(iName, std::vector<std::string>(iTexts));
}

long ZEPSysSettingRepository::SaveRepository(const char*) {
  if (!_modified) return S_OK;
  long rc = _saveHandler ? _saveHandler(*this) : S_OK;
  if (SUCCEEDED(rc)) _modified = false;
  return rc;
}

void ZEPSysSettingRepository::SetDefault(const std::string& iName, const Value& iValue) { _defaults[iName] = iValue; }

void ZEPSysSettingRepository::SetLock(const std::string& iName, bool iLocked, const std::string& iText) {
  if (iLocked) _locks[iName] = Lock{true, iText};
  else _locks.erase(iName);
}

bool ZEPSysSettingRepository::IsLocked(const std::string& iName) const {
  auto it = _locks.find(iName);
  return it != _locks.end() && it->second.locked;
}

long ZEPSysSettingRepository::GetLockInfo(const std::string& iName, ZEPSettingInfo& oInfo) const {
  auto it = _locks.find(iName);
  bool locked = it != _locks.end() && it->second.locked;
  oInfo.SetLocked(locked);
  oInfo.SetLockText(locked ? it->second.text : std::string());
  return S_OK;
}

int ZEPSysSettingRepository::ResetAttr(const std::string& iName) {
  if (IsLocked(iName)) return 0;
  if (_user.erase(iName)) {
    _modified = true;
    NoteWrite(iName.c_str());
  }
  return 1;
}

void ZEPSysSettingRepository::SetUserValue(const std::string& iName, const Value& iValue) {
  _writtenKnown = false;
  // Loading gives the names in order: then the value goes at the end without a search.
  if (_user.empty() || _user.rbegin()->first < iName) _user.emplace_hint(_user.end(), iName, iValue);
  else _user[iName] = iValue;
}

void ZEPSysSettingRepository::SetUserValues(std::map<std::string, Value>&& iValues) {
  _writtenKnown = false;
  if (_user.empty()) _user.swap(iValues);
  else
    for (auto& [name, value] : iValues) _user.insert_or_assign(name, std::move(value));
}

ZEPSysPreferenceRepository* ZEPSysPreferenceRepository::GetPreferenceRepository(const char* iName) {
  return Lookup<ZEPSysPreferenceRepository>(iName);
}

ZEPSysPreferenceRepository* ZEPSysPreferenceRepository::Open(const std::string& iName) {
  return OpenIn<ZEPSysPreferenceRepository>(iName);
}

void ZEPSysPreferenceRepository::Close(const std::string& iName) { Registry<ZEPSysPreferenceRepository>().erase(iName); }
void ZEPSysPreferenceRepository::CloseAll() { Registry<ZEPSysPreferenceRepository>().clear(); }
