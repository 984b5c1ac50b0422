#include "ZEPAppBinding.h"

#include <algorithm>
#include <type_traits>

namespace zepapp {

const std::vector<ZEPAppSetting>& AppSettings() {
  static const std::vector<ZEPAppSetting> settings = {
#define ZEP_APP_SETTING(Page, Attribute, Control, Repository, Stored, ...)                          \
  {#Page, #Attribute, Control, Repository, Stored, {__VA_ARGS__}, false, {}},
#define ZEP_APP_TEXT_SETTING(Page, Attribute, Control, Repository, Stored, ...)                     \
  {#Page, #Attribute, Control, Repository, Stored, {}, true, {__VA_ARGS__}},
#include "ZEPAppSettings.def"
#undef ZEP_APP_TEXT_SETTING
#undef ZEP_APP_SETTING
  };
  return settings;
}

const ZEPAppSetting* FindSetting(const std::string& iPage, const std::string& iAttribute) {
  for (int r = FirstSettingRow(iAttribute); r >= 0; r = kNextSameAttribute[static_cast<std::size_t>(r)])
    if (kAppSettingKeys[r].page == iPage) return &AppSettings()[static_cast<std::size_t>(r)];
  return nullptr;
}

const ZEPAppSetting* ZEPAppBinding::Setting(int iRow) const {
  for (int r = iRow; r >= 0; r = kNextSameAttribute[static_cast<std::size_t>(r)])
    if (kAppSettingKeys[r].page == _page) return &AppSettings()[static_cast<std::size_t>(r)];
  return nullptr;
}

namespace {
std::function<void(const ZEPAppSetting&)>& WriteObserver() {
  static std::function<void(const ZEPAppSetting&)> observer;
  return observer;
}
} // namespace

void SetWriteObserver(std::function<void(const ZEPAppSetting&)> iObserver) { WriteObserver() = std::move(iObserver); }

ZEPSysSettingRepository* ZEPAppBinding::Repository(const ZEPAppSetting& iSetting) const {
  return ZEPSysSettingRepository::GetRepository(iSetting.repository.c_str(), 0);
}

namespace {
template <ZEPAppStored S> struct StoredType;
template <> struct StoredType<ZEPAppStored::Int> { using type = int; };
template <> struct StoredType<ZEPAppStored::UInt> { using type = unsigned int; };
template <> struct StoredType<ZEPAppStored::Double> { using type = double; };

template <class T, class S> T FromStored(S iValue) {
  if constexpr (std::is_same_v<T, unsigned char>) return iValue != 0 ? 1 : 0; // a flag is 0 or 1
  else return static_cast<T>(iValue);
}
} // namespace

namespace {
// A text setting as the repository keeps it: one text, or the texts of a list in order.
std::vector<std::string> ToTexts(const ZEPUnicodeString& iText) { return {iText.str()}; }
std::vector<std::string> ToTexts(const ZEPListValZEPUnicodeString& iList) {
  std::vector<std::string> texts;
  for (const ZEPUnicodeString& t : iList.Items()) texts.push_back(t.str());
  return texts;
}
void FromTexts(const std::vector<std::string>& iTexts, ZEPUnicodeString& oText) {
  oText = iTexts.empty() ? ZEPUnicodeString() : ZEPUnicodeString(iTexts.front());
}
void FromTexts(const std::vector<std::string>& iTexts, ZEPListValZEPUnicodeString& oList) {
  oList.RemoveAll(1);
  for (const std::string& t : iTexts) oList.Append(ZEPUnicodeString(t));
}
} // namespace

template <class T> long ZEPAppBinding::Read(const ZEPAppSetting* setting, T* oValues, int iCount) {
  constexpr ZEPAppStored kind = StoredOf<T>();
  if constexpr (kind == ZEPAppStored::Unsupported) {
    (void)setting, (void)oValues, (void)iCount;
    return E_NOTIMPL;
  } else if constexpr (kind == ZEPAppStored::Text || kind == ZEPAppStored::TextList) {
    if (!setting || !oValues || iCount != 1) return E_FAIL;
    // The default first; the repository's texts replace it when it holds texts.
    std::vector<std::string> texts = setting->texts;
    if (ZEPSysSettingRepository* rep = Repository(*setting)) rep->ReadAttr(setting->stored.c_str(), texts);
    FromTexts(texts, *oValues);
    return S_OK;
  } else {
    using S = typename StoredType<kind>::type;
    if (!setting || !oValues || iCount <= 0) return E_FAIL;
    // The default first; the repository's values replace it where it has them.
    std::vector<S> buffer(static_cast<size_t>(iCount), S());
    for (int i = 0; i < iCount && i < static_cast<int>(setting->defaults.size()); ++i)
      buffer[static_cast<size_t>(i)] = static_cast<S>(setting->defaults[static_cast<size_t>(i)]);
    if (ZEPSysSettingRepository* rep = Repository(*setting)) rep->ReadAttr(setting->stored.c_str(), buffer.data(), iCount);
    for (int i = 0; i < iCount; ++i) oValues[i] = FromStored<T>(buffer[static_cast<size_t>(i)]);
    return S_OK;
  }
}

template <class T> long ZEPAppBinding::Write(const ZEPAppSetting* setting, const T* iValues, int iCount) {
  constexpr ZEPAppStored kind = StoredOf<T>();
  if constexpr (kind == ZEPAppStored::Unsupported) {
    (void)setting, (void)iValues, (void)iCount;
    return E_NOTIMPL;
  } else if constexpr (kind == ZEPAppStored::Text || kind == ZEPAppStored::TextList) {
    if (!setting || !iValues || iCount != 1) return E_FAIL;
    ZEPSysSettingRepository* rep = Repository(*setting);
    // Refused when locked, or for a text that is not UTF-8 or holds a NUL.
    if (!rep || rep->WriteAttr(setting->stored.c_str(), ToTexts(*iValues)) != 1) return E_FAIL;
    if (WriteObserver()) WriteObserver()(*setting);
    return S_OK;
  } else {
    using S = typename StoredType<kind>::type;
    if (!setting || !iValues || iCount <= 0) return E_FAIL;
    ZEPSysSettingRepository* rep = Repository(*setting);
    if (!rep) return E_FAIL;
    std::vector<S> buffer(iValues, iValues + iCount);
    if (rep->WriteAttr(setting->stored.c_str(), buffer.data(), iCount) != 1) return E_FAIL;
    if (WriteObserver()) WriteObserver()(*setting);
    return S_OK;
  }
}

long ZEPAppBinding::Info(int iRow, ZEPSettingInfo& oInfo) const {
  oInfo.Reset();
  const ZEPAppSetting* setting = Setting(iRow);
  if (ZEPSysSettingRepository* rep = setting ? Repository(*setting) : nullptr) rep->GetLockInfo(setting->stored, oInfo);
  return S_OK;
}

// The kinds the pages use.
template long ZEPAppBinding::Read(const ZEPAppSetting*, unsigned char*, int);
template long ZEPAppBinding::Read(const ZEPAppSetting*, int*, int);
template long ZEPAppBinding::Read(const ZEPAppSetting*, unsigned int*, int);
template long ZEPAppBinding::Read(const ZEPAppSetting*, double*, int);
template long ZEPAppBinding::Read(const ZEPAppSetting*, ZEPUnicodeString*, int);
template long ZEPAppBinding::Read(const ZEPAppSetting*, ZEPListValZEPUnicodeString*, int);
template long ZEPAppBinding::Write(const ZEPAppSetting*, const unsigned char*, int);
template long ZEPAppBinding::Write(const ZEPAppSetting*, const int*, int);
template long ZEPAppBinding::Write(const ZEPAppSetting*, const unsigned int*, int);
template long ZEPAppBinding::Write(const ZEPAppSetting*, const double*, int);
template long ZEPAppBinding::Write(const ZEPAppSetting*, const ZEPUnicodeString*, int);
template long ZEPAppBinding::Write(const ZEPAppSetting*, const ZEPListValZEPUnicodeString*, int);

} // namespace zepapp
