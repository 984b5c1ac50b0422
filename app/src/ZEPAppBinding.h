// Binds the setting hooks of a page to the host repositories, following ZEPAppSettings.def.
#pragma once

#include "ZEPDrwSettingHooks.h"

#include <array>
#include <functional>
#include <string_view>
#include <string>
#include <vector>

namespace zepapp {

// How a page's values are kept in a repository: flags and ints as int, unsigned ints as
// unsigned, lengths and angles as double (the sketcher reads the same attributes), a text
// (Text) or a list of texts (TextList) as texts.
enum class ZEPAppStored { Int, UInt, Double, Text, TextList, Unsupported };

template <class T> constexpr ZEPAppStored StoredOf() {
  if constexpr (std::is_same_v<T, double>) return ZEPAppStored::Double;
  else if constexpr (std::is_same_v<T, unsigned int>) return ZEPAppStored::UInt;
  else if constexpr (std::is_same_v<T, int> || std::is_same_v<T, unsigned char>) return ZEPAppStored::Int;
  else if constexpr (std::is_same_v<T, ZEPUnicodeString>) return ZEPAppStored::Text;
  else if constexpr (std::is_same_v<T, ZEPListValZEPUnicodeString>) return ZEPAppStored::TextList;
  else return ZEPAppStored::Unsupported;
}

// One row of ZEPAppSettings.def: ZEP_APP_SETTING rows have numbers as defaults,
// ZEP_APP_TEXT_SETTING rows texts (one text, or the texts of a list).
struct ZEPAppSetting {
  std::string page;       // "Grid"
  std::string attribute;  // "PrimSpaceH"
  std::string control;    // "editorGridSpacing"
  std::string repository; // "DrwSketcherSpecific"
  std::string stored;     // "Drw_settings_GridPrimarySpacing"
  std::vector<double> defaults;
  bool text = false;                 // a ZEP_APP_TEXT_SETTING row
  std::vector<std::string> texts;    // its default texts
};

const std::vector<ZEPAppSetting>& AppSettings();

// The rows of ZEPAppSettings.def by name, known when compiling, so that each hook of a page
// finds its row without searching the table.
struct ZEPAppSettingKey {
  std::string_view page, attribute;
};
inline constexpr ZEPAppSettingKey kAppSettingKeys[] = {
#define ZEP_APP_SETTING(Page, Attribute, ...) {#Page, #Attribute},
#define ZEP_APP_TEXT_SETTING(Page, Attribute, ...) {#Page, #Attribute},
#include "ZEPAppSettings.def"
#undef ZEP_APP_TEXT_SETTING
#undef ZEP_APP_SETTING
};
inline constexpr int kAppSettingCount = static_cast<int>(std::size(kAppSettingKeys));
// The first row from iFrom on of an attribute name; -1 when there is none.
constexpr int FirstSettingRow(std::string_view iAttribute, int iFrom = 0) {
  for (int r = iFrom; r < kAppSettingCount; ++r)
    if (kAppSettingKeys[r].attribute == iAttribute) return r;
  return -1;
}
// For each row, the next row of the same attribute name (on another page); -1 when none.
inline constexpr std::array<int, kAppSettingCount> kNextSameAttribute = [] {
  std::array<int, kAppSettingCount> next{};
  for (int r = 0; r < kAppSettingCount; ++r) next[static_cast<std::size_t>(r)] = FirstSettingRow(kAppSettingKeys[r].attribute, r + 1);
  return next;
}();

// Called after each successful write of a page's setting (e.g. to tell the sketcher);
// one observer, replaced by the next call; an empty function removes it.
void SetWriteObserver(std::function<void(const ZEPAppSetting&)> iObserver);
const ZEPAppSetting* FindSetting(const std::string& iPage, const std::string& iAttribute);

class ZEPAppBinding {
public:
  explicit ZEPAppBinding(std::string iPage) : _page(std::move(iPage)) {}

  // iRow: FirstSettingRow of the attribute's name (the hooks below give it when compiled).
  template <class T> long Get(int iRow, T& oValue) { return Read(Setting(iRow), &oValue, 1); }
  template <class T> long Get(int iRow, T* oValues, int iCount) { return Read(Setting(iRow), oValues, iCount); }
  template <class T> long Get(int iRow, T& oRed, T& oGreen, T& oBlue) {
    T rgb[3] = {oRed, oGreen, oBlue};
    long rc = Read(Setting(iRow), rgb, 3);
    oRed = rgb[0];
    oGreen = rgb[1];
    oBlue = rgb[2];
    return rc;
  }
  template <class T> long Set(int iRow, const T& iValue) { return Write(Setting(iRow), &iValue, 1); }
  template <class T> long Set(int iRow, const T* iValues, int iCount) { return Write(Setting(iRow), iValues, iCount); }
  template <class T> long Set(int iRow, const T& iRed, const T& iGreen, const T& iBlue) {
    const T rgb[3] = {iRed, iGreen, iBlue};
    return Write(Setting(iRow), rgb, 3);
  }
  // Every info hook answers 0: each control exists; the record says whether it is locked.
  long Info(int iRow, ZEPSettingInfo& oInfo) const;

private:
  // The setting of this page among the rows of the attribute's name from iRow on; null if none.
  const ZEPAppSetting* Setting(int iRow) const;
  template <class T> long Read(const ZEPAppSetting* iSetting, T* oValues, int iCount);
  template <class T> long Write(const ZEPAppSetting* iSetting, const T* iValues, int iCount);
  ZEPSysSettingRepository* Repository(const ZEPAppSetting& iSetting) const;

  std::string _page;
};

} // namespace zepapp

// The hooks of an application page, generated from the page's table.
#define ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)                                                      \
  long SetSys##Name(ZEP_SETPARAMS(Kind)) override {                                                 \
    static constexpr int kRow = zepapp::FirstSettingRow(#Name);                                     \
    return _binding.Set(kRow, ZEP_SETARGS(Kind));                                                   \
  }                                                                                                 \
  long GetSys##Name(ZEP_GETPARAMS(Kind)) override {                                                 \
    static constexpr int kRow = zepapp::FirstSettingRow(#Name);                                     \
    return _binding.Get(kRow, ZEP_GETARGS(Kind));                                                   \
  }                                                                                                 \
  long GetSys##Name##Info(ZEPSettingInfo& oInfo) override {                                         \
    static constexpr int kRow = zepapp::FirstSettingRow(#Name);                                     \
    return _binding.Info(kRow, oInfo);                                                              \
  }
