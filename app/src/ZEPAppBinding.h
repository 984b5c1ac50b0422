// Binds the setting hooks of a page to the host repositories, following ZEPAppSettings.def.
#pragma once

#include "ZEPDrwSettingHooks.h"

#include <functional>
#include <string>
#include <vector>

namespace zepapp {

// How a page's values are kept in a repository: flags and ints as int, unsigned ints as
// unsigned, lengths and angles as double (the sketcher reads the same attributes).
enum class ZEPAppStored { Int, UInt, Double, Unsupported };

template <class T> constexpr ZEPAppStored StoredOf() {
  if constexpr (std::is_same_v<T, double>) return ZEPAppStored::Double;
  else if constexpr (std::is_same_v<T, unsigned int>) return ZEPAppStored::UInt;
  else if constexpr (std::is_same_v<T, int> || std::is_same_v<T, unsigned char>) return ZEPAppStored::Int;
  else return ZEPAppStored::Unsupported;
}

// One row of ZEPAppSettings.def.
struct ZEPAppSetting {
  std::string page;       // "Grid"
  std::string attribute;  // "PrimSpaceH"
  std::string control;    // "editorGridSpacing"
  std::string repository; // "DrwSketcherSpecific"
  std::string stored;     // "Drw_settings_GridPrimarySpacing"
  std::vector<double> defaults;
};

const std::vector<ZEPAppSetting>& AppSettings();

// Called after each successful write of a page's setting (e.g. to tell the sketcher);
// one observer, replaced by the next call; an empty function removes it.
void SetWriteObserver(std::function<void(const ZEPAppSetting&)> iObserver);
const ZEPAppSetting* FindSetting(const std::string& iPage, const std::string& iAttribute);

class ZEPAppBinding {
public:
  explicit ZEPAppBinding(std::string iPage) : _page(std::move(iPage)) {}

  template <class T> long Get(const char* iAttribute, T& oValue) { return Read(iAttribute, &oValue, 1); }
  template <class T> long Get(const char* iAttribute, T* oValues, int iCount) {
    return Read(iAttribute, oValues, iCount);
  }
  template <class T> long Get(const char* iAttribute, T& oRed, T& oGreen, T& oBlue) {
    T rgb[3] = {oRed, oGreen, oBlue};
    long rc = Read(iAttribute, rgb, 3);
    oRed = rgb[0];
    oGreen = rgb[1];
    oBlue = rgb[2];
    return rc;
  }
  template <class T> long Set(const char* iAttribute, const T& iValue) { return Write(iAttribute, &iValue, 1); }
  template <class T> long Set(const char* iAttribute, const T* iValues, int iCount) {
    return Write(iAttribute, iValues, iCount);
  }
  template <class T> long Set(const char* iAttribute, const T& iRed, const T& iGreen, const T& iBlue) {
    const T rgb[3] = {iRed, iGreen, iBlue};
    return Write(iAttribute, rgb, 3);
  }
  // Every info hook answers 0: each control exists; the record says whether it is locked.
  long Info(const char* iAttribute, ZEPSettingInfo& oInfo) const;

private:
  template <class T> long Read(const char* iAttribute, T* oValues, int iCount);
  template <class T> long Write(const char* iAttribute, const T* iValues, int iCount);
  ZEPSysSettingRepository* Repository(const ZEPAppSetting& iSetting) const;

  std::string _page;
};

} // namespace zepapp

// The hooks of an application page, generated from the page's table.
#define ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)                                                      \
  long SetSys##Name(ZEP_SETPARAMS(Kind)) override { return _binding.Set(#Name, ZEP_SETARGS(Kind)); } \
  long GetSys##Name(ZEP_GETPARAMS(Kind)) override { return _binding.Get(#Name, ZEP_GETARGS(Kind)); } \
  long GetSys##Name##Info(ZEPSettingInfo& oInfo) override { return _binding.Info(#Name, oInfo); }
