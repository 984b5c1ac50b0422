#include "ZEPDrwSettingsServices.h"

#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockCombo.h"
#include "ZEPDrwLockComboColor.h"
#include "ZEPDrwLockComboDashed.h"
#include "ZEPDrwLockComboSymbol.h"
#include "ZEPDrwLockComboWeight.h"
#include "ZEPDrwLockIconBox.h"
#include "ZEPDrwLockSlider.h"
#include "ZEPDrwLockSpinner.h"

#include <climits>
#include <cmath>

namespace {
const char* const kPath = "DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEPDrwSettingsServices";

// A page's Write hears every control of the page: only a notification sent by this
// control's inner control is this control's value.
template <class C, class F> long ReadIfSender(C* iControl, ZEPCommand* iSender, F iRead) {
  if (!iControl || !iSender || iSender != iControl->GetDialog()) return E_FAIL;
  return iRead(*iControl);
}

template <class C, class F> long UpdateIfControl(C* iControl, F iUpdate) {
  if (!iControl) return E_FAIL;
  iUpdate(*iControl);
  return S_OK;
}

const struct {
  const char* name;
  ZEPDlgUnit unit;
} kLengthUnits[] = {{"METER", 43},   {"micron", 44}, {"MM", 45},   {"CM", 46},
                    {"KM", 47},      {"INCH", 48},   {"FOOT", 49}, {"F_I_F64", 50},
                    {"F_I_F16", 51}, {"F_I_DEC", 52}};
const ZEPDlgUnit kMillimetre = 45, kRadian = 11, kDegree = 12, kGrade = 15;

// Length factor of a scale range: model lengths at that range are this many times larger.
double RangeFactor(ZEPCkeScale iRange) {
  switch (iRange) {
  case 2:
    return 100.0;
  case 3:
    return 10000.0;
  case 4:
    return 0.01;
  case 5:
    return 0.0001;
  default:
    return 1.0;
  }
}

// The unit the user works with for a magnitude type; iDefault when the host has none.
ZEPUnicodeString UserUnit(const ZEPICkeType_var& iType, ZEPCkeScale iScale, const char* iDefault,
                          const char* iMagnitudeCheck, const char* iUnitCheck) {
  ZEPICkeMagnitude_var spMagnitude = iType;
  if (!spMagnitude) {
    Check_Handler_Failed__(iMagnitudeCheck, kPath, __LINE__, nullptr);
    return iDefault;
  }
  ZEPICkeUnit_var spUnit;
  spMagnitude->GetScaleUnit(spUnit, iScale);
  if (!spUnit) {
    Check_Handler_Failed__(iUnitCheck, kPath, __LINE__, nullptr);
    return iDefault;
  }
  return spUnit->GetUnitName();
}

void ApplyUnit(ZEPDlgControl* iDlgControl, ZEPDlgUnit iUnit, int iPrecision,
               unsigned char iPrecisionFlag) {
  iDlgControl->SetUnit(iUnit);
  if (iPrecision > 0) iDlgControl->SetPrecision(iPrecision, iPrecisionFlag);
}

// Limits are doubles: a spinner of whole numbers keeps its own.
bool TakesDoubleLimits(ZEPDlgSpinner* iDlgSpinner) {
  if (!iDlgSpinner) {
    Check_Pointer_Failed__("iDlgSpinner", kPath, __LINE__, nullptr);
    return false;
  }
  if (!(iDlgSpinner->GetStyle() & ZEPDlgSpnDouble)) {
    Check_TRUE_Failed__("iDlgSpinner->GetStyle()&ZEPDlgSpnDouble", kPath, __LINE__, nullptr);
    return false;
  }
  return true;
}
} // namespace

// ---- value transfer ---------------------------------------------------------------------------
long ZEPDrwSettingsServices::GetValueFromCheckButton(ZEPDrwLockCheckButton* iControl,
                                                     ZEPCommand* iSender, unsigned char& oValue) {
  return ReadIfSender(iControl, iSender, [&](ZEPDrwLockCheckButton& c) {
    oValue = c.GetState() == ZEPDlgChecked ? 1 : 0;
    return S_OK;
  });
}

long ZEPDrwSettingsServices::GetValueFromCombo(ZEPDrwLockCombo* iControl, ZEPCommand* iSender,
                                               int& oIndex) {
  return ReadIfSender(iControl, iSender, [&](ZEPDrwLockCombo& c) {
    ZEPDlgCombo* pCombo = c.GetCombo();
    if (!pCombo) return E_FAIL;
    oIndex = pCombo->GetSelect();
    return S_OK;
  });
}

long ZEPDrwSettingsServices::GetValueFromCombo(ZEPDrwLockCombo* iControl, ZEPCommand* iSender,
                                               ZEPUnicodeString& oText) {
  return ReadIfSender(iControl, iSender, [&](ZEPDrwLockCombo& c) {
    ZEPDlgCombo* pCombo = c.GetCombo();
    if (!pCombo) return E_FAIL;
    pCombo->GetLine(oText, pCombo->GetSelect());
    return S_OK;
  });
}

long ZEPDrwSettingsServices::GetValueFromComboColor(ZEPDrwLockComboColor* iControl,
                                                    ZEPCommand* iSender, int& oRed, int& oGreen,
                                                    int& oBlue) {
  return ReadIfSender(iControl, iSender, [&](ZEPDrwLockComboColor& c) {
    unsigned int red = 0, green = 0, blue = 0;
    c.GetSelectedColor(&red, &green, &blue);
    if (red > 255 || green > 255 || blue > 255) return E_FAIL;
    oRed = static_cast<int>(red);
    oGreen = static_cast<int>(green);
    oBlue = static_cast<int>(blue);
    return S_OK;
  });
}

long ZEPDrwSettingsServices::GetValueFromComboSymbol(ZEPDrwLockComboSymbol* iControl,
                                                     ZEPCommand* iSender, int& oValue) {
  return ReadIfSender(iControl, iSender, [&](ZEPDrwLockComboSymbol& c) {
    oValue = static_cast<int>(c.GetSelect());
    return S_OK;
  });
}

long ZEPDrwSettingsServices::GetValueFromIconBox(ZEPDrwLockIconBox* iControl, ZEPCommand* iSender,
                                                 int& oValue) {
  return ReadIfSender(iControl, iSender, [&](ZEPDrwLockIconBox& c) {
    oValue = c.GetSelect();
    return S_OK;
  });
}

long ZEPDrwSettingsServices::GetValueFromLineType(ZEPDrwLockComboDashed* iControl,
                                                  ZEPCommand* iSender, int& oValue) {
  return ReadIfSender(iControl, iSender, [&](ZEPDrwLockComboDashed& c) {
    oValue = static_cast<int>(c.GetSelect());
    return S_OK;
  });
}

long ZEPDrwSettingsServices::GetValueFromSlider(ZEPDrwLockSlider* iControl, ZEPCommand* iSender,
                                                float& oValue) {
  return ReadIfSender(iControl, iSender, [&](ZEPDrwLockSlider& c) {
    oValue = c.GetCurrentValue();
    return S_OK;
  });
}

long ZEPDrwSettingsServices::GetValueFromSpinner(ZEPDrwLockSpinner* iControl, ZEPCommand* iSender,
                                                 int& oValue) {
  return ReadIfSender(iControl, iSender, [&](ZEPDrwLockSpinner& c) {
    // Converting a double outside the int range is undefined: such values are clamped.
    double value = std::trunc(c.GetValue());
    oValue = value >= INT_MAX    ? INT_MAX
             : value <= INT_MIN  ? INT_MIN
             : std::isnan(value) ? 0
                                 : static_cast<int>(value);
    c.SetValue(oValue, 0);
    return S_OK;
  });
}

long ZEPDrwSettingsServices::GetValueFromSpinner(ZEPDrwLockSpinner* iControl, ZEPCommand* iSender,
                                                 const double& iFactor, double& oValue) {
  return ReadIfSender(iControl, iSender, [&](ZEPDrwLockSpinner& c) {
    oValue = c.GetValue() * iFactor;
    return S_OK;
  });
}

long ZEPDrwSettingsServices::GetValueFromThickness(ZEPDrwLockComboWeight* iControl,
                                                   ZEPCommand* iSender, int& oValue) {
  return ReadIfSender(iControl, iSender, [&](ZEPDrwLockComboWeight& c) {
    oValue = static_cast<int>(c.GetSelect());
    return S_OK;
  });
}

long ZEPDrwSettingsServices::UpdateCheckButton(ZEPDrwLockCheckButton* iControl,
                                               const unsigned char& iValue) {
  return UpdateIfControl(iControl, [&](ZEPDrwLockCheckButton& c) {
    c.SetState(iValue != 0 ? ZEPDlgChecked : ZEPDlgUnchecked, 0);
  });
}

long ZEPDrwSettingsServices::UpdateCombo(ZEPDrwLockCombo* iControl, const unsigned int& iIndex) {
  ZEPDlgCombo* pCombo = iControl ? iControl->GetCombo() : nullptr;
  if (!pCombo) return E_FAIL;
  pCombo->SetSelect(static_cast<int>(iIndex), 0);
  return S_OK;
}

long ZEPDrwSettingsServices::UpdateCombo(ZEPDrwLockCombo* iControl, const ZEPUnicodeString& iText) {
  ZEPDlgCombo* pCombo = iControl ? iControl->GetCombo() : nullptr;
  if (!pCombo) return E_FAIL;
  pCombo->SetSelect(iText, 0);
  return S_OK;
}

// A negative int becomes a huge unsigned value, refused with the components above 255.
long ZEPDrwSettingsServices::UpdateComboColor(ZEPDrwLockComboColor* iControl, const int& iRed,
                                              const int& iGreen, const int& iBlue) {
  return UpdateComboColor(iControl, static_cast<unsigned int>(iRed),
                          static_cast<unsigned int>(iGreen), static_cast<unsigned int>(iBlue));
}

long ZEPDrwSettingsServices::UpdateComboColor(ZEPDrwLockComboColor* iControl,
                                              const unsigned int& iRed, const unsigned int& iGreen,
                                              const unsigned int& iBlue) {
  if (!iControl || iRed > 255 || iGreen > 255 || iBlue > 255) return E_FAIL;
  iControl->SetSelectedColor(iRed, iGreen, iBlue);
  return S_OK;
}

long ZEPDrwSettingsServices::UpdateComboLineType(ZEPDrwLockComboDashed* iControl,
                                                 const unsigned int& iValue) {
  return UpdateIfControl(iControl, [&](ZEPDrwLockComboDashed& c) { c.SetSelect(iValue); });
}

long ZEPDrwSettingsServices::UpdateComboSymbol(ZEPDrwLockComboSymbol* iControl,
                                               const unsigned int& iValue) {
  return UpdateIfControl(iControl, [&](ZEPDrwLockComboSymbol& c) { c.SetSelect(iValue); });
}

long ZEPDrwSettingsServices::UpdateComboThickness(ZEPDrwLockComboWeight* iControl,
                                                  const unsigned int& iValue) {
  return UpdateIfControl(iControl, [&](ZEPDrwLockComboWeight& c) { c.SetSelect(iValue); });
}

long ZEPDrwSettingsServices::UpdateIconBox(ZEPDrwLockIconBox* iControl, const int& iValue) {
  return UpdateIfControl(iControl, [&](ZEPDrwLockIconBox& c) { c.SetSelect(iValue, 0); });
}

long ZEPDrwSettingsServices::UpdateSlider(ZEPDrwLockSlider* iControl, const float& iValue) {
  return UpdateIfControl(iControl, [&](ZEPDrwLockSlider& c) { c.SetCurrentValue(iValue, 0); });
}

long ZEPDrwSettingsServices::UpdateSpinner(ZEPDrwLockSpinner* iControl, const double& iValue) {
  return UpdateIfControl(iControl, [&](ZEPDrwLockSpinner& c) { c.SetValue(iValue, 0); });
}

// ---- units and value ranges -----------------------------------------------------------------
ZEPUnicodeString ZEPDrwSettingsServices::GetLengthUnit(unsigned char iPaper, ZEPCkeScale iRange) {
  if (!iPaper) {
    ZEPCkeValueServices::ForceDictionaryInit();
    return UserUnit(ZEPParmDictionary::LengthType(), iRange, "MM", "spLengthMagnitudeCke",
                    "spLengthUnit");
  }
  ZEPSysSettingRepository* pRep = ZEPSysSettingRepository::GetRepository("DraftingOptions", 0);
  if (!pRep) {
    Check_Pointer_Failed__("pRep", kPath, __LINE__, nullptr);
    return "MM";
  }
  int paperUnit = 1; // kept when the attribute is missing
  pRep->ReadAttr("DrwPaperLengthUnit", &paperUnit, 1);
  return paperUnit == 3 ? "CM" : paperUnit == 5 ? "INCH" : "MM";
}

ZEPUnicodeString ZEPDrwSettingsServices::GetAngleUnit() {
  ZEPCkeValueServices::ForceDictionaryInit();
  return UserUnit(ZEPParmDictionary::AngleType(), ZEPCkeScaleNormal, "DEGREE",
                  "spAngleMagnitudeCke", "spAngleUnit");
}

void ZEPDrwSettingsServices::SetLengthUnitToDlgControl(ZEPDlgControl* iDlgControl,
                                                       ZEPCkeScale iRange, unsigned char iPaper,
                                                       int iPrecision,
                                                       unsigned char iPrecisionFlag) {
  if (!iDlgControl) return Check_Pointer_Failed__("iDlgControl", kPath, __LINE__, nullptr);
  ZEPUnicodeString name = GetLengthUnit(iPaper, iRange);
  ZEPDlgUnit unit = 0;
  for (const auto& u : kLengthUnits)
    if (name == u.name) unit = u.unit;
  if (!unit) {
    CheckFailure__("Not supported unit", kPath, __LINE__, nullptr);
    unit = kMillimetre;
  }
  ApplyUnit(iDlgControl, unit, iPrecision, iPrecisionFlag);
}

void ZEPDrwSettingsServices::SetAngleUnitToDlgControl(ZEPDlgControl* iDlgControl, int iPrecision,
                                                      unsigned char iPrecisionFlag) {
  if (!iDlgControl) return Check_Pointer_Failed__("iDlgControl", kPath, __LINE__, nullptr);
  ZEPUnicodeString name = GetAngleUnit();
  ZEPDlgUnit unit = name == "RADIAN" ? kRadian : name == "GRADE" ? kGrade : kDegree;
  ApplyUnit(iDlgControl, unit, iPrecision, iPrecisionFlag);
}

void ZEPDrwSettingsServices::SetLengthMinMaxStep(ZEPDlgSpinner* iDlgSpinner, ZEPCkeScale iRange,
                                                 unsigned char iPaper, double iMin, double iMax,
                                                 double iStep) {
  if (!TakesDoubleLimits(iDlgSpinner)) return;
  ZEPUnicodeString name = GetLengthUnit(iPaper, iRange);
  // Paper inches get a finer step; the step never follows the range.
  if (iPaper && name == "INCH") iStep /= 10.0;
  iStep /= 1000.0;
  iMin /= 1000.0;
  iMax /= 1000.0;
  if (!iPaper) {
    iMin *= RangeFactor(iRange);
    iMax *= RangeFactor(iRange);
  }
  iDlgSpinner->SetMinMaxStep(iMin, iMax, iStep, 0);
}

void ZEPDrwSettingsServices::SetAngleMinMaxStep(ZEPDlgSpinner* iDlgSpinner, double iMin,
                                                double iMax, double iStep) {
  if (!TakesDoubleLimits(iDlgSpinner)) return;
  const double degreesToRadians = 0.017453292519943295;
  iDlgSpinner->SetMinMaxStep(iMin * degreesToRadians, iMax * degreesToRadians,
                             iStep * degreesToRadians, 0);
}

// ---- drafting standard files --------------------------------------------------------------
long ZEPDrwSettingsServices::GetXmlFilesNames(const ZEPUnicodeString& iType,
                                              unsigned char iKeepExtension,
                                              ZEPListValZEPUnicodeString& oNames) {
  oNames.RemoveAll(1);
  ZEPUnicodeString type = iType;
  ZEPListValZEPUnicodeString* pFiles = ZEPStdServices::GetStandardFiles(type);
  if (!pFiles) return E_FAIL;
  for (int i = 1; i <= pFiles->Size(); ++i) {
    ZEPUnicodeString name = (*pFiles)[i];
    int length = name.GetLengthInChar();
    if (length < 4 || name.SubString(length - 4, 4).ToLower() != ".xml") continue;
    if (iKeepExtension == 0) name.RemoveTail(4);
    oNames.Append(name);
  }
  delete pFiles;
  // After stripping: ISO.xml and ISO.XML are one standard.
  oNames.RemoveDuplicates();
  oNames.QuickSort(CompareStdStrings);
  return S_OK;
}

int ZEPDrwSettingsServices::CompareStdStrings(ZEPUnicodeString* iFirst, ZEPUnicodeString* iSecond) {
  return *iFirst > *iSecond ? 1 : -1;
}
