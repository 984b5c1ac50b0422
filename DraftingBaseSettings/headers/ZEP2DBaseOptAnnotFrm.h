// Options page of annotations and tables: text and leader snapping, rigid positional links,
// the legend table layout, table resizing, splitting and custom sort lists, area fill. Hosts
// whose callout size overrun setting answers its info hook with 0 get the callout layout
// instead (callout creation and legend table only). The custom sort lists and the legend table
// layout are dialogs of the newer dialog framework; at most one of them is open at a time.
#pragma once

#include "ZEPDrwSettingHooks.h"

class ZEPDrwLockCheckButton;
class ZEPDrwLockFrame;
class ZEPDrwLockSpinner;
class ZEPVidFraDialog;

class ZEP2DBaseOptAnnotFrm : public ZEPDlgFrame {
public:
  ~ZEP2DBaseOptAnnotFrm() override;
  ZEPString GetResourceFilename(int iIndex = 0) const override;
  void Build();
  void Initialize();

protected:
  ZEP2DBaseOptAnnotFrm(ZEPDialog* iParent, const ZEPString& iName);

#define ZEP_SETTING(Name, Kind) ZEP_DECLARE_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptAnnotFrm.def"
#undef ZEP_SETTING

  // Handed unchanged to the legend table layout dialog.
  virtual ZEPString GetLegendTableLayoutContext() = 0;

private:
  enum Slot {
#define ZEP_SETTING(Name, Kind) ZEP_SETTING_SLOT(Name)
#include "ZEP2DBaseOptAnnotFrm.def"
#undef ZEP_SETTING
    kSlotCount
  };
  class EventHandler;
  friend class EventHandler;

  static const ZEPSettingSlotHooks<ZEP2DBaseOptAnnotFrm>& Hooks(int iSlot);
  ZEPDrwLockCheckButton* Check(ZEPDialog* iFrame, int iSlot, const char* iName, short iRow,
                               short iColumn, short iWidth, ZEPSettingInfo& ioInfo);
  ZEPDlgPushButton* MoreButton(ZEPDialog* iFrame, const char* iName, short iRow);
  void BuildCalloutCreation(ZEPSettingInfo& ioInfo);
  void BuildAnnotationCreation(ZEPSettingInfo& ioInfo);
  void BuildLegendTable();
  void BuildTables(ZEPSettingInfo& ioInfo);
  void BuildAreaFill(ZEPSettingInfo& ioInfo);
  void UpdateWidgets();
  void Write(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void NotifPush(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void CB_CustomListPanelClose(ZEPBaseUnknown* iSender, ZEPSYPEventArgs* iArgs);
  // Has CB_CustomListPanelClose called for iEvent of iWidget.
  void Subscribe(ZEPVidWidget* iWidget, const ZEPSYPEvent& iEvent);
  // The open dialog; null when there is none or the host has destroyed it.
  ZEPVidFraDialog* OpenDialog();
  // Hides the open dialog, asks for its destruction and forgets it.
  void ReleaseDialog();

  // The check button of each flag attribute (null for other kinds and absent controls).
  ZEPDrwLockCheckButton* _pChk[kSlotCount] = {};
  ZEPDlgRadioButton* _pRadOptimGenAndGeo = nullptr;
  ZEPDlgRadioButton* _pRadOptimImport = nullptr;
  ZEPDrwLockSpinner* _pSpnCalloutSizeOverrun = nullptr;
  ZEPDlgPushButton* _pPushTableSortCustomLists = nullptr;
  ZEPDlgPushButton* _pPushLegendTableLayout = nullptr;
  ZEPVidFraDialog* _pFraDialog = nullptr;
  ZEPBaseUnknown_WR _fraDialogRef; // notices a dialog the host destroyed

  // Cached values; a flag's value sits at its slot.
  unsigned char _bFlag[kSlotCount] = {};
  int _iAreaFillOptimizationMode = 0;
  double _dCalloutSizeOverrun = 0.0;
};
