// Static services of the options pages: value transfer between lock-aware controls and page
// variables, units and limits of length and angle controls, and drafting standard names.
#pragma once

#include "ZEPHost.h"

class ZEPDrwLockCheckButton;
class ZEPDrwLockCombo;
class ZEPDrwLockComboColor;
class ZEPDrwLockComboDashed;
class ZEPDrwLockComboSymbol;
class ZEPDrwLockComboWeight;
class ZEPDrwLockIconBox;
class ZEPDrwLockSlider;
class ZEPDrwLockSpinner;

class ZEPDrwSettingsServices {
public:
  // ---- Value transfer --------------------------------------------------------------------
  // GetValueFrom*: E_FAIL, output untouched, unless iSender is the control's inner control
  // (a page's Write tries its controls in turn); else the value is read and S_OK answered.
  static long GetValueFromCheckButton(ZEPDrwLockCheckButton* iControl, ZEPCommand* iSender,
                                      unsigned char& oValue);
  static long GetValueFromCombo(ZEPDrwLockCombo* iControl, ZEPCommand* iSender, int& oIndex);
  static long GetValueFromCombo(ZEPDrwLockCombo* iControl, ZEPCommand* iSender,
                                ZEPUnicodeString& oText);
  // E_FAIL, outputs untouched, for a component above 255.
  static long GetValueFromComboColor(ZEPDrwLockComboColor* iControl, ZEPCommand* iSender, int& oRed,
                                     int& oGreen, int& oBlue);
  static long GetValueFromComboSymbol(ZEPDrwLockComboSymbol* iControl, ZEPCommand* iSender,
                                      int& oValue);
  static long GetValueFromIconBox(ZEPDrwLockIconBox* iControl, ZEPCommand* iSender, int& oValue);
  static long GetValueFromLineType(ZEPDrwLockComboDashed* iControl, ZEPCommand* iSender,
                                   int& oValue);
  static long GetValueFromSlider(ZEPDrwLockSlider* iControl, ZEPCommand* iSender, float& oValue);
  // Truncated toward zero (clamped to the int range) and shown back in the spinner.
  static long GetValueFromSpinner(ZEPDrwLockSpinner* iControl, ZEPCommand* iSender, int& oValue);
  // The spinner's value times iFactor (1000.0: metres to millimetres).
  static long GetValueFromSpinner(ZEPDrwLockSpinner* iControl, ZEPCommand* iSender,
                                  const double& iFactor, double& oValue);
  static long GetValueFromThickness(ZEPDrwLockComboWeight* iControl, ZEPCommand* iSender,
                                    int& oValue);

  // Update*: shows the value; E_FAIL for a null control (and the checks noted).
  static long UpdateCheckButton(ZEPDrwLockCheckButton* iControl, const unsigned char& iValue);
  // E_FAIL as well without an inner combo.
  static long UpdateCombo(ZEPDrwLockCombo* iControl, const unsigned int& iIndex);
  static long UpdateCombo(ZEPDrwLockCombo* iControl, const ZEPUnicodeString& iText);
  // E_FAIL as well for a component outside 0 to 255.
  static long UpdateComboColor(ZEPDrwLockComboColor* iControl, const int& iRed, const int& iGreen,
                               const int& iBlue);
  static long UpdateComboColor(ZEPDrwLockComboColor* iControl, const unsigned int& iRed,
                               const unsigned int& iGreen, const unsigned int& iBlue);
  static long UpdateComboLineType(ZEPDrwLockComboDashed* iControl, const unsigned int& iValue);
  static long UpdateComboSymbol(ZEPDrwLockComboSymbol* iControl, const unsigned int& iValue);
  static long UpdateComboThickness(ZEPDrwLockComboWeight* iControl, const unsigned int& iValue);
  static long UpdateIconBox(ZEPDrwLockIconBox* iControl, const int& iValue);
  static long UpdateSlider(ZEPDrwLockSlider* iControl, const float& iValue);
  // iValue in the spinner's own unit (metres, radians).
  static long UpdateSpinner(ZEPDrwLockSpinner* iControl, const double& iValue);

  // ---- Units and value ranges ------------------------------------------------------------
  // The user's length unit at that range, or the paper length unit when iPaper is not 0.
  static void SetLengthUnitToDlgControl(ZEPDlgControl* iDlgControl, ZEPCkeScale iRange,
                                        unsigned char iPaper, int iPrecision,
                                        unsigned char iPrecisionFlag);
  static void SetAngleUnitToDlgControl(ZEPDlgControl* iDlgControl, int iPrecision,
                                       unsigned char iPrecisionFlag);
  // Limits in millimetres; model lengths follow the range, paper lengths do not.
  static void SetLengthMinMaxStep(ZEPDlgSpinner* iDlgSpinner, ZEPCkeScale iRange,
                                  unsigned char iPaper, double iMin, double iMax, double iStep);
  // Limits in degrees.
  static void SetAngleMinMaxStep(ZEPDlgSpinner* iDlgSpinner, double iMin, double iMax,
                                 double iStep);

  // ---- Drafting standard files -----------------------------------------------------------
  // The sorted names of the XML files of that standard type, without ".xml" when
  // iKeepExtension is 0. oNames holds only this result; E_FAIL when the container has no list.
  static long GetXmlFilesNames(const ZEPUnicodeString& iType, unsigned char iKeepExtension,
                               ZEPListValZEPUnicodeString& oNames);

private:
  friend class ZEPDrwSettingsServicesTest;
  static ZEPUnicodeString GetLengthUnit(unsigned char iPaper, ZEPCkeScale iRange);
  static ZEPUnicodeString GetAngleUnit();
  // 1 when the first is greater, else -1 (never 0).
  static int CompareStdStrings(ZEPUnicodeString* iFirst, ZEPUnicodeString* iSecond);
};
