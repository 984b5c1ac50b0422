// Options page of what the administrator decides: drafting standard and upgrade protections,
// template creation, the frames and title blocks folder, styles and the property toolbar
// behaviours (a dialog of their own), generative view styles, locked annotations, name
// unicity, the selection scope in an assembly and, behind the ZEP_TDE_LA switch, true
// dimensions. Which frames and controls exist is the host's choice (its operations and info
// hooks).
#pragma once

#include "ZEPDrwSettingHooks.h"
#include "ZEPDrwSubDialog.h"

class ZEPDrwLockCheckButton;
class ZEPDrwLockCombo;
class ZEPDrwLockEditor;

class ZEP2DBaseOptAdminFrm : public ZEPDlgFrame {
public:
  ~ZEP2DBaseOptAdminFrm() override;
  ZEPString GetResourceFilename(int iIndex = 0) const override;
  // iNoStyles non-zero leaves out the template creation and manufacturing requirements checks
  // and the styles frame with its behaviour dialog.
  void Build(unsigned char iNoStyles);
  void Initialize();

protected:
  ZEP2DBaseOptAdminFrm(ZEPDialog* iParent, const ZEPString& iName);

  // Icon of the drawing management frame.
  virtual ZEPString GetFrameIconName() = 0;
  // Generative view styles: their frame, and the element-type line of four behaviours.
  virtual unsigned char WithFrmGVS() = 0;
  virtual unsigned char WithFrmAssemblyMgmt() = 0;
  // Where the behaviour dialog's place is saved when it closes; null: not saved.
  virtual ZEPSysPreferenceRepository* GetDlgPreferenceRepository() = 0;
  virtual unsigned char WithFrmTitleBlock() = 0;

#define ZEP_SETTING(Name, Kind) ZEP_DECLARE_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptAdminFrm.def"
#undef ZEP_SETTING

public:
  enum Slot {
#define ZEP_SETTING(Name, Kind) ZEP_SETTING_SLOT(Name)
#include "ZEP2DBaseOptAdminFrm.def"
#undef ZEP_SETTING
    kSlotCount
  };
  static constexpr int kBehaviorCount = kSlotSelectionOnCurrentAssembly - kSlotDrwTbFontName;
  // Behaviour values (the combo lines' meanings).
  enum Behavior { kFix = 0, kElemType = 1, kStyle = 2, kNoOverload = 3 };

private:
  struct BehaviorRow;
  static const ZEPSettingSlotHooks<ZEP2DBaseOptAdminFrm>& Hooks(int iSlot);
  // The behaviour dialog's rows, in hook and screen order.
  static const BehaviorRow& Behavior(int iRow);
  long Info(int iSlot, ZEPSettingInfo& oInfo) { return (this->*Hooks(iSlot).info)(oInfo); }
  ZEPDrwLockCheckButton* Check(ZEPDialog* iFrame, int iSlot, const char* iName, short iRow,
                               short iColumn, short iWidth, ZEPSettingInfo& ioInfo);
  // The check on the running row when its info status passes (not negative, or exactly 0).
  void CheckIf(ZEPDialog* iFrame, int iSlot, const char* iName, short& ioRow, short iWidth,
               bool iExactlyZero, ZEPSettingInfo& ioInfo);
  ZEPDlgRadioButton* Radio(ZEPDialog* iGroup, const char* iName, short iRow, short iColumn,
                           const ZEPUnicodeString* iLongHelp);
  void UpdateWidgets();
  void UpdateShowWarningCheckButtons();
  void UpdateDistinguish();
  void SetEnabled(ZEPDrwLockCheckButton* iCheck, bool iEnabled);
  void SendRestartMsg();
  void Write(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  bool WriteRadios(ZEPCommand* iSender);
  void NotifPush(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void CloseDlg(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void BuildDlgPropTbBehavior(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo);
  // Conversions between a behaviour's stored value and its combo line.
  int IndexOfBehavior(int iRow, int iValue);
  int BehaviorOfIndex(int iRow, int iIndex);

  // The check button of each flag attribute (null for other kinds and absent controls).
  ZEPDrwLockCheckButton* _pChk[kSlotCount] = {};
  ZEPDlgPushButton* _pPushPropTbBehavior = nullptr;
  ZEPDrwLockEditor* _pEdtFolderTitleBlock = nullptr;
  ZEPDrwLockCombo* _pCmbBehavior[kBehaviorCount] = {};
  ZEPDlgRadioButton* _pRadElemUnderCurAssemblyRoot = nullptr;
  ZEPDlgRadioButton* _pRadElemUnderCurFavContextRoot = nullptr;
  ZEPDlgRadioButton* _pRadAnyRelevantElement = nullptr;
  ZEPDlgRadioButton* _pRadSelectedAssGeom = nullptr;
  ZEPDlgRadioButton* _pRadSelectedAssGeomWithAnnotation = nullptr;
  ZEPDlgRadioButton* _pRadViewNameUnicityInSheet = nullptr;
  ZEPDlgRadioButton* _pRadViewNameUnicityInLayout = nullptr;
  ZEPDrwSubDialog _dlgPropTbBehavior{"dlgPropTbBehavior", 0x11400201};

  // Cached values; a flag's value sits at its slot, a behaviour's combo line at its row.
  ZEPUnicodeString _folderTitleBlock;
  int _iBehavior[kBehaviorCount] = {};
  int _iSelectionOnCurrentAssembly = 0;
  int _iViewNameUnicityScope = 0;
  int _iEnggConLocation = 0;
  unsigned char _bFlag[kSlotCount] = {};
};
