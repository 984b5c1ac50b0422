#include "ZEP2DBaseOptAnnotFrm.h"

#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockFrame.h"
#include "ZEPDrwLockLabel.h"
#include "ZEPDrwLockSpinner.h"
#include "ZEPDrwSettingsServices.h"

#define ZEP_SETTING(Name, Kind) ZEP_DEFINE_SETTING_HOOKS(ZEP2DBaseOptAnnotFrm, Name, Kind)
#include "ZEP2DBaseOptAnnotFrm.def"
#undef ZEP_SETTING

#define ZEP_ANNOT_PATH "DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEP2DBaseOptAnnotFrm"

namespace {
using Services = ZEPDrwSettingsServices;

ZEPDlgFrame* Section(ZEPDialog* iParent, const char* iName, const char* iIcon, short iRow) {
  auto* section = new ZEPDlgToolsOptionsFrame(iParent, iName, iIcon, 4);
  section->SetGridConstraints(iRow, 0, 1, 1, 0x1E);
  return section->GetOptionsFrame();
}

void Label(ZEPDialog* iFrame, const char* iName, int iWithText, short iRow, short iWidth = 1) {
  (new ZEPDrwLockLabel(iFrame, iName, iWithText))->SetGridConstraints(iRow, 0, iWidth, 1, 0x1E);
}
} // namespace

// Calls a member of the page for the events it subscribed to, as long as the page lives: the
// host keeps handlers, and may raise their events, after the page is gone.
class ZEP2DBaseOptAnnotFrm::EventHandler : public ZEPSYPEventHandler {
public:
  using Method = void (ZEP2DBaseOptAnnotFrm::*)(ZEPBaseUnknown*, ZEPSYPEventArgs*);
  EventHandler(ZEP2DBaseOptAnnotFrm* iPage, Method iMethod) : _page(iPage), _method(iMethod) {}
  void Handle(ZEPBaseUnknown* iSender, ZEPBaseUnknown* iArgs) override {
    auto* page = static_cast<ZEP2DBaseOptAnnotFrm*>(_page.Resolve());
    if (!page) return;
    (page->*_method)(iSender, ZEPSysDynamicCast<ZEPSYPEventArgs>(iArgs));
  }

private:
  ZEPBaseUnknown_WR _page;
  Method _method;
};

const ZEPSettingSlotHooks<ZEP2DBaseOptAnnotFrm>& ZEP2DBaseOptAnnotFrm::Hooks(int iSlot) {
  static const ZEPSettingSlotHooks<ZEP2DBaseOptAnnotFrm> hooks[] = {
#define ZEP_SETTING(Name, Kind) ZEP_SETTING_SLOT_HOOKS(ZEP2DBaseOptAnnotFrm, Name, Kind)
#include "ZEP2DBaseOptAnnotFrm.def"
#undef ZEP_SETTING
  };
  static_assert(sizeof hooks / sizeof hooks[0] == kSlotCount, "one row of hooks per attribute");
  return hooks[iSlot];
}

ZEP2DBaseOptAnnotFrm::ZEP2DBaseOptAnnotFrm(ZEPDialog* iParent, const ZEPString& iName)
    : ZEPDlgFrame(iParent, iName, 0x80001) {}

ZEP2DBaseOptAnnotFrm::~ZEP2DBaseOptAnnotFrm() {
  // A dialog still open would otherwise stay in the host for good.
  ReleaseDialog();
  for (ZEPDrwLockCheckButton*& check : _pChk)
    check = nullptr;
  _pRadOptimGenAndGeo = _pRadOptimImport = nullptr;
  _pSpnCalloutSizeOverrun = nullptr;
  _pPushTableSortCustomLists = _pPushLegendTableLayout = nullptr;
}

ZEPString ZEP2DBaseOptAnnotFrm::GetResourceFilename(int iIndex) const {
  if (iIndex >= 1) return ZEPDlgFrame::GetResourceFilename(iIndex - 1);
  return "ZEPDrwFrameAnnot";
}

// ---- widget tree ------------------------------------------------------------------------------
ZEPDrwLockCheckButton* ZEP2DBaseOptAnnotFrm::Check(ZEPDialog* iFrame, int iSlot, const char* iName,
                                                   short iRow, short iColumn, short iWidth,
                                                   ZEPSettingInfo& ioInfo) {
  (this->*Hooks(iSlot).info)(ioInfo);
  auto* check = new ZEPDrwLockCheckButton(iFrame, iName, ioInfo, 0);
  check->SetGridConstraints(iRow, iColumn, iWidth, 1, 0x1E);
  AddAnalyseNotificationCB(check->GetDialog(), check->GetChkBModifyNotification(),
                           &ZEP2DBaseOptAnnotFrm::Write, nullptr);
  return _pChk[iSlot] = check;
}

ZEPDlgPushButton* ZEP2DBaseOptAnnotFrm::MoreButton(ZEPDialog* iFrame, const char* iName,
                                                   short iRow) {
  auto* push = new ZEPDlgPushButton(iFrame, iName, 0);
  push->SetGridConstraints(iRow, 1, 1, 1, 0x02);
  push->SetIconName("I_D3M_MoreParameters", "", "", "", 0);
  AddAnalyseNotificationCB(push, push->GetPushBActivateNotification(),
                           &ZEP2DBaseOptAnnotFrm::NotifPush, nullptr);
  return push;
}

void ZEP2DBaseOptAnnotFrm::Build() {
  ZEPSettingInfo info;
  if (GetSysCalloutSizeOverrunInfo(info) == 0) {
    BuildCalloutCreation(info);
    BuildLegendTable();
    return;
  }
  BuildAnnotationCreation(info);
  BuildLegendTable();
  BuildTables(info);
  BuildAreaFill(info);
}

void ZEP2DBaseOptAnnotFrm::BuildCalloutCreation(ZEPSettingInfo& ioInfo) {
  ZEPDlgFrame* frame = Section(this, "toolCalloutCreation", "I_D3M_CalloutCreation", 0);
  Label(frame, "lblCalloutSizeOverrun", 1, 0);
  GetSysCalloutSizeOverrunInfo(ioInfo);
  _pSpnCalloutSizeOverrun = new ZEPDrwLockSpinner(frame, "edtCalloutSizeOverrun", ioInfo, 0x60000);
  _pSpnCalloutSizeOverrun->SetGridConstraints(0, 1, 1, 1, 0x1E);
  _pSpnCalloutSizeOverrun->SetVisibleTextWidth(5);
  Services::SetLengthUnitToDlgControl(_pSpnCalloutSizeOverrun->GetSpinner(), ZEPCkeScaleNormal, 1,
                                      1, 1);
  Services::SetLengthMinMaxStep(_pSpnCalloutSizeOverrun->GetSpinner(), ZEPCkeScaleNormal, 1, 0.0,
                                100.0, 1.0);
  AddAnalyseNotificationCB(_pSpnCalloutSizeOverrun->GetDialog(),
                           _pSpnCalloutSizeOverrun->GetSpinnerModifyNotification(),
                           &ZEP2DBaseOptAnnotFrm::Write, nullptr);
  Check(frame, kSlotEnableCreateCallout, "chkEnableCreateCallout", 1, 0, 2, ioInfo);
}

void ZEP2DBaseOptAnnotFrm::BuildAnnotationCreation(ZEPSettingInfo& ioInfo) {
  ZEPDlgFrame* frame = Section(this, "frameAnnotCreation", "I_D3M_Text", 0);
  Check(frame, kSlotTextAlongRef, "TextSnappingOn", 0, 0, 1, ioInfo);
  Label(frame, "labelSnappingOn", 1, 1);
  auto* snapping = new ZEPDlgFrame(frame, "frmAnnotCreation", 0x80001);
  snapping->SetGridConstraints(2, 0, 1, 1, 0x1E);
  Label(snapping, "labelInv", 0, 0);
  Check(snapping, kSlotLeaderTextNormal, "TextLeadSnappingOn", 0, 1, 1, ioInfo);
  Check(snapping, kSlotLeaderGDTNormal, "GDTSnappingOn", 1, 1, 1, ioInfo);
  Label(frame, "labelRigidPosLink", 1, 3);
  auto* links = new ZEPDlgFrame(frame, "frmPosLinkCreation", 0x80001);
  links->SetGridConstraints(4, 0, 1, 1, 0x1E);
  Label(links, "labelInv1", 0, 0);
  Check(links, kSlotTextRigidPosLink, "checkTextRigidPosLink", 0, 1, 1, ioInfo);
  Check(links, kSlotTableRigidPosLink, "checkTableRigidPosLink", 1, 1, 1, ioInfo);
  Check(links, kSlotGDTRigidPosLink, "checkGDTRigidPosLink", 2, 1, 1, ioInfo);
}

void ZEP2DBaseOptAnnotFrm::BuildLegendTable() {
  ZEPDlgFrame* frame = Section(this, "frmLegendTable", "I_D3M_LegendTable", 1);
  (new ZEPDlgLabel(frame, "lblTableLayout", 0))->SetGridConstraints(0, 0, 1, 1, 0x1E);
  _pPushLegendTableLayout = MoreButton(frame, "pushLegendTableLayout", 0);
}

void ZEP2DBaseOptAnnotFrm::BuildTables(ZEPSettingInfo& ioInfo) {
  ZEPDlgFrame* frame = Section(this, "frmTable", "I_D3M_Table", 2);
  Check(frame, kSlotRecomputeTable, "chkTableResize", 0, 0, 2, ioInfo);
  Check(frame, kSlotPreventTableSplit, "chkTableAutoSplit", 1, 0, 2, ioInfo);
  Label(frame, "lblTableSortCustomLists", 1, 2);
  _pPushTableSortCustomLists = MoreButton(frame, "pushTableSortCustomLists", 2);
}

void ZEP2DBaseOptAnnotFrm::BuildAreaFill(ZEPSettingInfo& ioInfo) {
  ZEPDlgFrame* frame = Section(this, "frmAreaFill", "I_D3M_AreaFill", 3);
  Check(frame, kSlotAskForDelSupport, "chkAskForDelSupport", 0, 0, 2, ioInfo);
  Label(frame, "lblAFOptimForGeom", 1, 1, 2);
  Label(frame, "invLock", 0, 2);
  GetSysAreaFillOptimizationModeInfo(ioInfo);
  auto* group = new ZEPDrwLockFrame(frame, "frmAFOptimForGeom", ioInfo, 0x80001);
  group->SetGridConstraints(2, 1, 1, 1, 0x1E);
  ZEPDialog* radios = group->GetDialog();
  if (!radios) return;
  ZEPDlgRadioButton** members[] = {&_pRadOptimGenAndGeo, &_pRadOptimImport};
  const char* names[] = {"radOptimGenAndGeo", "radOptimImport"};
  for (short i = 0; i < 2; ++i) {
    auto* radio = *members[i] = new ZEPDlgRadioButton(radios, names[i], 0);
    radio->SetGridConstraints(i, 0, 1, 1, 0x1E);
    AddAnalyseNotificationCB(radio, radio->GetRadBModifyNotification(),
                             &ZEP2DBaseOptAnnotFrm::Write, nullptr);
  }
}

// ---- values -------------------------------------------------------------------------------------
void ZEP2DBaseOptAnnotFrm::Initialize() {
  for (int slot = 0; slot < kSlotCount; ++slot) {
    if (auto get = Hooks(slot).get)
      (this->*get)(_bFlag[slot]);
    else if (slot == kSlotAreaFillOptimizationMode)
      GetSysAreaFillOptimizationMode(_iAreaFillOptimizationMode);
    else if (slot == kSlotCalloutSizeOverrun)
      GetSysCalloutSizeOverrun(_dCalloutSizeOverrun);
  }
  UpdateWidgets();
}

void ZEP2DBaseOptAnnotFrm::UpdateWidgets() {
  for (int slot = 0; slot < kSlotCount; ++slot)
    if (Hooks(slot).get) Services::UpdateCheckButton(_pChk[slot], _bFlag[slot]);
  if (_pRadOptimGenAndGeo && _pRadOptimImport) {
    // Other stored values leave both radios as they are.
    if (_iAreaFillOptimizationMode == 0) _pRadOptimGenAndGeo->SetState(ZEPDlgChecked, 0);
    if (_iAreaFillOptimizationMode == 1) _pRadOptimImport->SetState(ZEPDlgChecked, 0);
  }
  // Set with notification, as the host asks; the toolkit's setters never notify, so opening
  // the page writes nothing.
  if (_pSpnCalloutSizeOverrun) _pSpnCalloutSizeOverrun->SetValue(_dCalloutSizeOverrun * 0.001, 1);
}

void ZEP2DBaseOptAnnotFrm::Write(ZEPCommand* iSender, ZEPNotification*, void*) {
  for (int slot = 0; slot < kSlotCount; ++slot) {
    if (!Hooks(slot).set ||
        Services::GetValueFromCheckButton(_pChk[slot], iSender, _bFlag[slot]) < 0)
      continue;
    (this->*Hooks(slot).set)(_bFlag[slot]);
    return;
  }
  if (_pRadOptimGenAndGeo && _pRadOptimImport &&
      (iSender == _pRadOptimGenAndGeo || iSender == _pRadOptimImport)) {
    const int mode = _pRadOptimGenAndGeo->GetState() == ZEPDlgChecked ? 0 : 1;
    if (mode == _iAreaFillOptimizationMode) return;
    _iAreaFillOptimizationMode = mode;
    SetSysAreaFillOptimizationMode(_iAreaFillOptimizationMode);
    return;
  }
  if (Services::GetValueFromSpinner(_pSpnCalloutSizeOverrun, iSender, 1000.0,
                                    _dCalloutSizeOverrun) >= 0)
    SetSysCalloutSizeOverrun(_dCalloutSizeOverrun);
}

// ---- the two dialogs ----------------------------------------------------------------------------
ZEPVidFraDialog* ZEP2DBaseOptAnnotFrm::OpenDialog() {
  if (_pFraDialog && !_fraDialogRef.Resolve()) {
    _pFraDialog = nullptr;
    _fraDialogRef.Clear();
  }
  return _pFraDialog;
}

void ZEP2DBaseOptAnnotFrm::ReleaseDialog() {
  if (ZEPVidFraDialog* dialog = OpenDialog()) {
    dialog->SetVisibleFlag(0);
    dialog->RequestDelayedDestruction();
  }
  _pFraDialog = nullptr;
  _fraDialogRef.Clear();
}

void ZEP2DBaseOptAnnotFrm::Subscribe(ZEPVidWidget* iWidget, const ZEPSYPEvent& iEvent) {
  auto* handler = new EventHandler(this, &ZEP2DBaseOptAnnotFrm::CB_CustomListPanelClose);
  iWidget->AddHandler(iEvent, handler, 0);
  handler->Release(); // the widget keeps its own reference
}

void ZEP2DBaseOptAnnotFrm::NotifPush(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (!iSender) {
    Check_Pointer_Failed__("iFrom", ZEP_ANNOT_PATH, __LINE__, nullptr);
    return;
  }
  if (OpenDialog()) {
    Check_TRUE_Failed__("!_pFraDialog", ZEP_ANNOT_PATH, __LINE__, nullptr);
    return;
  }
  if (iSender == _pPushTableSortCustomLists) {
    _pFraDialog = ZEPDbsManageCustomListVID::CreateCustomListDialog(this);
    if (!_pFraDialog) {
      Check_Pointer_Failed__("_pFraDialog", ZEP_ANNOT_PATH, __LINE__, nullptr);
      return;
    }
    _fraDialogRef = ZEPBaseUnknown_WR(_pFraDialog);
    auto* panel = ZEPSysDynamicCast<ZEPDbsManageCustomListVID>(_pFraDialog->GetApplicativeWidget());
    if (!panel) {
      Check_Pointer_Failed__("pPanel", ZEP_ANNOT_PATH, __LINE__, nullptr);
      ReleaseDialog(); // a dialog kept here would refuse every later press
      return;
    }
    panel->BuildFromPreferencesAndSettings();
    Subscribe(panel, ZEPDbsManageCustomListVID::AcceptBtnPressed());
    Subscribe(panel, ZEPDbsManageCustomListVID::CancelBtnPressed());
  } else if (iSender == _pPushLegendTableLayout) {
    _pFraDialog = ZEPDbsLegendTableLayoutVID::CreateLegendTableLayoutDialog(
        this, GetLegendTableLayoutContext());
    if (!_pFraDialog) {
      Check_Pointer_Failed__("_pFraDialog", ZEP_ANNOT_PATH, __LINE__, nullptr);
      return;
    }
    _fraDialogRef = ZEPBaseUnknown_WR(_pFraDialog);
    Subscribe(_pFraDialog, ZEPVidFraDialog::RejectButtonClicked());
  } else {
    return;
  }
  // A dialog that ends on its own (accepted on the host's side) must free the buttons too.
  Subscribe(_pFraDialog, ZEPVidFraWindow::Closed());
  _pFraDialog->SetLifeCycle(2);
  _pFraDialog->SetVisibleFlag(1);
}

void ZEP2DBaseOptAnnotFrm::CB_CustomListPanelClose(ZEPBaseUnknown* iSender,
                                                   ZEPSYPEventArgs* iArgs) {
  ZEPVidFraDialog* dialog = OpenDialog();
  if (!dialog) {
    Check_Pointer_Failed__("_pFraDialog", ZEP_ANNOT_PATH, __LINE__, nullptr);
    return;
  }
  // An event of a dialog this page has already let go of.
  if (iSender != dialog && iSender != dialog->GetApplicativeWidget()) return;
  dialog->SetVisibleFlag(0);
  if (!iArgs)
    Check_Pointer_Failed__("ipArgs", ZEP_ANNOT_PATH, __LINE__, nullptr);
  else
    iArgs->Consume();
  // Released even without arguments: a dialog kept here would refuse every later press.
  ReleaseDialog();
}
