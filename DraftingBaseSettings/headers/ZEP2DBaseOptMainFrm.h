// Options page of the drafting standard and the scale: the standard chosen among the folder
// standards and the PLM standards (added through the PLM object chooser, removed again), the
// default scale ratio of each scale range, and the insert and shareable drawing flags.
#pragma once

#include "ZEPDrwSettingHooks.h"

class ZEPDrwLockCheckButton;
class ZEPDrwLockCombo;
class ZEPDrwLockPushButton;
class ZEP2DBaseRangeCmb;

class ZEP2DBaseOptMainFrm : public ZEPDlgFrame {
public:
  ~ZEP2DBaseOptMainFrm() override;
  ZEPString GetResourceFilename(int iIndex = 0) const override;
  // Answers the number of rows used in the main frame (0 when it could not be made).
  int Build();
  void Initialize();

  // Values kept per scale range.
  static constexpr int kRangeCount = 5;

protected:
  ZEP2DBaseOptMainFrm(ZEPDialog* iParent, const ZEPString& iName);

  // Supplied by the hosting application: the icon of the "MainFrm" section, and the standard
  // that becomes current when the current PLM standard is removed.
  virtual ZEPString GetFrameIconName() = 0;
  virtual ZEPUnicodeString GetDefaultStandardName() = 0;
  // The folder standards offered, in order. By default the sorted names of the "drafting"
  // standard files, without extension.
  virtual void GetListOfStandardTypedFolder(ZEPListValZEPUnicodeString& oNames);

#define ZEP_SETTING(Name, Kind) ZEP_DECLARE_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptMainFrm.def"
#undef ZEP_SETTING

private:
  void UpdateWidgets();
  // iDropping: the list is opening; a current name that is no choice is then not offered.
  void UpdateComboStd(bool iDropping);
  void UpdateScaleRatioEditors();
  void UpdateShareableSensitivity();
  void Write(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void WriteStandard();
  void WriteScaleRatio();
  void ComboNotif(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void NotifPush(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void OpenPLMChooser();
  void RemovePLMStandard();
  void ClosePLMChooser(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void ReleasePLMChooser();
  // Index of the current range in the ratio array.
  int Index() const { return _currentRange - 1; }

  ZEPDlgFrame* _pMainFrame = nullptr;
  ZEPListValZEPUnicodeString _lstStdFolder;
  ZEPListValZEPUnicodeString _lstStdPLMNames;
  ZEPListValZEPUnicodeString _lstStdPLMIDs;
  ZEPIPLMChooser* _pPLMObjectChooser = nullptr; // one reference while open
  ZEPDrwLockCombo* _cmbStandardName = nullptr;
  ZEPDrwLockCheckButton* _pChkInsertDrawing = nullptr;
  ZEPDrwLockCheckButton* _pChkMakeDrawingShareable = nullptr;
  ZEPDrwLockPushButton* _pPushStandardPLMAdd = nullptr;
  ZEPDrwLockPushButton* _pPushStandardPLMRemove = nullptr;
  ZEPDlgEditor* _pEdtScaleRatio = nullptr;
  ZEPDlgEditor* _pEdtScaleRatioDec = nullptr;
  ZEP2DBaseRangeCmb* _pCmbRatioRange = nullptr;
  ZEPUnicodeString _standardName;
  double _dScaleRatio[kRangeCount];
  int _currentRange = 1;
  unsigned char _bInsertDrawing = 0;
  unsigned char _bMakeDrawingShareable = 0;
};
