// Options page of what drafting data shows: the specification tree, the analysis display mode
// that colours annotations by their state, the diagnosis colours of sketch geometry, back and
// cutting planes and view frame backgrounds, and the capping of section cuts. Two push buttons
// open dialogs: the analysed states with their colours ("dlgAnalysisDisplay") and the four
// diagnosis colours ("dlgVisuDiagColor"). The host decides which optional frames exist.
#pragma once

#include "ZEPDrwSettingHooks.h"
#include "ZEPDrwSubDialog.h"

class ZEPDrwLockCheckButton;
class ZEPDrwLockComboColor;
class ZEPDrwLockComboWeight;

class ZEP2DBaseOptDisplayFrm : public ZEPDlgFrame {
public:
  ~ZEP2DBaseOptDisplayFrm() override;
  ZEPString GetResourceFilename(int iIndex = 0) const override;
  // Places the page's frames on rows ioRow, ioRow + 1, ... of the caller's grid and leaves
  // ioRow on the next free row. iWithTrackHistory: "checkTrackHistory" may be built.
  void Build(int& ioRow, unsigned char iWithTrackHistory);
  void Initialize();

protected:
  ZEP2DBaseOptDisplayFrm(ZEPDialog* iParent, const ZEPString& iName);

#define ZEP_SETTING(Name, Kind) ZEP_DECLARE_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptDisplayFrm.def"
#undef ZEP_SETTING

  // Which optional frames exist: the page's visualisation and capping frames, the analysis
  // display dialog's geometries, callouts, welding and patterns frames.
  virtual unsigned char WithFrmVisualization() = 0;
  virtual unsigned char WithFrmGeometries() = 0;
  virtual unsigned char WithFrmCallouts() = 0;
  virtual unsigned char WithFrmWelding() = 0;
  virtual unsigned char WithFrmPatterns() = 0;
  virtual unsigned char WithFrmCapping() = 0;

private:
  enum Slot {
#define ZEP_SETTING(Name, Kind) ZEP_SETTING_SLOT(Name)
#include "ZEP2DBaseOptDisplayFrm.def"
#undef ZEP_SETTING
    kSlotCount
  };
  struct StateRow;
  struct DiagRow;
  struct ColorHooks;
  static const StateRow kStateRows[];
  static const DiagRow kDiagRows[];

  static const ZEPSettingSlotHooks<ZEP2DBaseOptDisplayFrm>& Hooks(int iSlot);
  static const ColorHooks& ColorHooksOf(int iSlot);
  ZEPDrwLockCheckButton* Check(ZEPDialog* iFrame, int iSlot, const char* iName, short iRow,
                               short iColumn, short iWidth, unsigned int iJustification,
                               ZEPSettingInfo& ioInfo, bool iOptional);
  ZEPDrwLockComboColor* ColorCombo(ZEPDialog* iFrame, int iSlot, const char* iName, short iRow,
                                   short iColumn, unsigned int iJustification,
                                   ZEPSettingInfo& ioInfo);
  ZEPDlgRadioButton* Radio(ZEPDialog* iGroup, const char* iName, short iRow, short iWidth);
  ZEPDlgPushButton* PushButton(ZEPDialog* iFrame, const char* iName, short iRow);
  void BuildTree(int& ioRow, unsigned char iWithTrackHistory, ZEPSettingInfo& ioInfo);
  void BuildDesignMode(int& ioRow, ZEPSettingInfo& ioInfo);
  void BuildVisualization(int& ioRow, ZEPSettingInfo& ioInfo);
  void BuildCapping(int& ioRow, ZEPSettingInfo& ioInfo);
  void BuildDlgAnalysisDisplay(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo);
  void BuildDlgVisuDiagColor(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo);
  void ShowColor(int iSlot);
  void UpdateWidgets();
  // Sensitivity of what depends on the value of iSlot; false when nothing does.
  bool UpdateDependants(int iSlot);
  void Write(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  bool WriteRadios(ZEPCommand* iSender);
  void NotifPush(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void CloseDlg(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);

  // The check button of each flag attribute and the colour combo of each colour attribute
  // (null for other kinds and absent controls).
  ZEPDrwLockCheckButton* _pChk[kSlotCount] = {};
  ZEPDrwLockComboColor* _pCmbColor[kSlotCount] = {};
  ZEPDrwLockComboWeight* _pCmbPatternContourPitch = nullptr;
  ZEPDlgRadioButton* _pRadBackgroundInViewFrameAuto = nullptr;
  ZEPDlgRadioButton* _pRadBackgroundInViewFrameDemand = nullptr;
  ZEPDlgRadioButton* _pRadCappingColorFix = nullptr;
  ZEPDlgRadioButton* _pRadCappingColorFromFace = nullptr;
  ZEPDlgRadioButton* _pRadCappingPatternNone = nullptr;
  ZEPDlgRadioButton* _pRadCappingPatternMaterial = nullptr;
  ZEPDlgPushButton* _pPushDiagElementsColors = nullptr;
  ZEPDlgPushButton* _pPushDiagGeometriesColors = nullptr;
  ZEPDrwSubDialog _dlgAnalysisDisplay{"dlgAnalysisDisplay"};
  ZEPDrwSubDialog _dlgVisuDiagColor{"dlgVisuDiagColor"};

  // Cached values: a flag's value, an int's value and a colour sit at their slot.
  unsigned char _bFlag[kSlotCount] = {};
  int _iValue[kSlotCount] = {};
  int _iColor[kSlotCount][3] = {};
  unsigned int _uColor[kSlotCount][3] = {};
};
