// Options page of the sketch geometry: centres and end points of generated geometry, direct
// manipulation with its drag options, smart pick and its colour, constraint creation and
// display, and the ditto options. The drawing grid page is embedded at its top; three push
// buttons open sub-dialogs (drag options, smart pick kinds, constraint types shown).
#pragma once

#include "ZEPDrwSettingHooks.h"
#include "ZEPDrwSubDialog.h"

class ZEPDrwLockCheckButton;
class ZEPDrwLockComboColor;
class ZEPDrwLockSpinner;
class ZEP2DBaseOptGridFrm;

class ZEP2DBaseOptGeoFrm : public ZEPDlgFrame {
public:
  ~ZEP2DBaseOptGeoFrm() override;
  ZEPString GetResourceFilename(int iIndex = 0) const override;
  void Build();
  void Initialize();

protected:
  ZEP2DBaseOptGeoFrm(ZEPDialog* iParent, const ZEPString& iName);

#define ZEP_SETTING(Name, Kind) ZEP_DECLARE_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptGeoFrm.def"
#undef ZEP_SETTING

  // The grid page to embed at the top, a child of this page; null for none.
  virtual ZEP2DBaseOptGridFrm* CreateGridFrame() = 0;

private:
  enum Slot {
#define ZEP_SETTING(Name, Kind) ZEP_SETTING_SLOT(Name)
#include "ZEP2DBaseOptGeoFrm.def"
#undef ZEP_SETTING
    kSlotCount
  };
  static const ZEPSettingSlotHooks<ZEP2DBaseOptGeoFrm>& Hooks(int iSlot);
  // A check button of a sub-dialog: the slot of its flag, its name and cell.
  struct DialogCheck {
    int slot;
    const char* name;
    short row, column;
  };
  template <std::size_t N>
  void BuildChecks(ZEPDialog* iFrame, const DialogCheck (&iChecks)[N], ZEPSettingInfo& ioInfo);
  ZEPDrwLockCheckButton* Check(ZEPDialog* iFrame, int iSlot, const char* iName, short iRow,
                               short iColumn, short iWidth, ZEPSettingInfo& ioInfo);
  ZEPDrwLockComboColor* ColorCombo(ZEPDialog* iFrame, const char* iName, short iRow, short iColumn,
                                   short iWidth, const ZEPSettingInfo& iInfo);
  ZEPDlgPushButton* PushButton(ZEPDialog* iFrame, const char* iFrameName, const char* iName,
                               short iRow, short iWidth);
  void UpdateWidgets();
  void UpdateDragSensitivity();
  void UpdateCstVisuSensitivity();
  void Write(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void NotifPush(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void CloseDlg(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void BuildDlgAllowGeomManip(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo);
  void BuildDlgSmartPick(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo);
  void BuildDlgTypeCst(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo);

  ZEP2DBaseOptGridFrm* _pGridFrame = nullptr;
  // The check button of each flag attribute (null for other kinds and absent controls).
  ZEPDrwLockCheckButton* _pChk[kSlotCount] = {};
  ZEPDrwLockSpinner* _pSpnRefSizeCst = nullptr;
  ZEPDrwLockComboColor* _pCmbColorCst = nullptr;
  ZEPDrwLockComboColor* _pCmbSmartPick = nullptr;
  ZEPDlgPushButton* _pPushDragOption = nullptr;
  ZEPDlgPushButton* _pPushSmartPick = nullptr;
  ZEPDlgPushButton* _pPushCstTypes = nullptr;
  ZEPDlgRadioButton* _pRadDragModeStd = nullptr;
  ZEPDlgRadioButton* _pRadDragModeMin = nullptr;
  ZEPDlgRadioButton* _pRadDragModeRel = nullptr;
  ZEPDrwSubDialog _dlgAllowGeomManip{"geoAllowGeomManip"};
  ZEPDrwSubDialog _dlgSmartPick{"geoSmartPick"};
  ZEPDrwSubDialog _dlgTypeCst{"geoTypeCst"};

  // Cached values; a flag's value sits at its slot.
  unsigned char _bFlag[kSlotCount] = {};
  double _dRefSizeCst = 0.0;
  int _iColorCst[3] = {0, 0, 0};
  int _iDragSolveMode = 0;
  unsigned int _uSmartPick[3] = {0, 0, 0};
};
