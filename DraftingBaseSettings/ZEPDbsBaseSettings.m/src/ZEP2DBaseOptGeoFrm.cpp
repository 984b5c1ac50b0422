#include "ZEP2DBaseOptGeoFrm.h"

#include "ZEP2DBaseOptGridFrm.h"
#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockComboColor.h"
#include "ZEPDrwLockFrame.h"
#include "ZEPDrwLockLabel.h"
#include "ZEPDrwLockSpinner.h"
#include "ZEPDrwSettingsServices.h"

#define ZEP_SETTING(Name, Kind) ZEP_DEFINE_SETTING_HOOKS(ZEP2DBaseOptGeoFrm, Name, Kind)
#include "ZEP2DBaseOptGeoFrm.def"
#undef ZEP_SETTING

namespace {
using Services = ZEPDrwSettingsServices;

ZEPDlgFrame* Section(ZEPDialog* iParent, const char* iName, const char* iIcon, short iRow) {
  auto* section = new ZEPDlgToolsOptionsFrame(iParent, iName, iIcon, *iIcon ? 4 : 6);
  section->SetGridConstraints(iRow, 0, 1, 1, 0x1E);
  return section->GetOptionsFrame();
}

unsigned long Sensitivity(bool iEnabled) { return iEnabled ? ZEPDlgEnable : ZEPDlgDisable; }
} // namespace

const ZEPSettingSlotHooks<ZEP2DBaseOptGeoFrm>& ZEP2DBaseOptGeoFrm::Hooks(int iSlot) {
  static const ZEPSettingSlotHooks<ZEP2DBaseOptGeoFrm> hooks[] = {
#define ZEP_SETTING(Name, Kind) ZEP_SETTING_SLOT_HOOKS(ZEP2DBaseOptGeoFrm, Name, Kind)
#include "ZEP2DBaseOptGeoFrm.def"
#undef ZEP_SETTING
  };
  static_assert(sizeof hooks / sizeof hooks[0] == kSlotCount, "one row of hooks per attribute");
  return hooks[iSlot];
}

ZEP2DBaseOptGeoFrm::ZEP2DBaseOptGeoFrm(ZEPDialog* iParent, const ZEPString& iName)
    : ZEPDlgFrame(iParent, iName, 0x80001) {
  _dlgAllowGeomManip.Track(_pChk[kSlotDragWithEndPts], _pRadDragModeStd, _pRadDragModeMin,
                           _pRadDragModeRel);
  _dlgSmartPick.Track(_pChk[kSlotSmartPickCoincid], _pChk[kSlotSmartPickAlign],
                      _pChk[kSlotSmartPickParaPerpenTang], _pChk[kSlotSmartPickHoriVerti]);
  _dlgTypeCst.Track(_pChk[kSlotCstVisuHori], _pChk[kSlotCstVisuVerti], _pChk[kSlotCstVisuPara],
                    _pChk[kSlotCstVisuPerpen], _pChk[kSlotCstVisuConcen], _pChk[kSlotCstVisuCoinci],
                    _pChk[kSlotCstVisuTangen], _pChk[kSlotCstVisuSym]);
}

ZEP2DBaseOptGeoFrm::~ZEP2DBaseOptGeoFrm() {
  _pGridFrame = nullptr;
  for (ZEPDrwLockCheckButton*& check : _pChk)
    check = nullptr;
  _pSpnRefSizeCst = nullptr;
  _pCmbColorCst = _pCmbSmartPick = nullptr;
  _pPushDragOption = _pPushSmartPick = _pPushCstTypes = nullptr;
  _pRadDragModeStd = _pRadDragModeMin = _pRadDragModeRel = nullptr;
}

ZEPString ZEP2DBaseOptGeoFrm::GetResourceFilename(int iIndex) const {
  if (iIndex >= 1) return ZEPDlgFrame::GetResourceFilename(iIndex - 1);
  return "ZEP2DBaseOptGeoFrm";
}

// ---- widget tree ------------------------------------------------------------------------------
ZEPDrwLockCheckButton* ZEP2DBaseOptGeoFrm::Check(ZEPDialog* iFrame, int iSlot, const char* iName,
                                                 short iRow, short iColumn, short iWidth,
                                                 ZEPSettingInfo& ioInfo) {
  (this->*Hooks(iSlot).info)(ioInfo);
  auto* check = new ZEPDrwLockCheckButton(iFrame, iName, ioInfo, 0);
  check->SetGridConstraints(iRow, iColumn, iWidth, 1, 0x1E);
  AddAnalyseNotificationCB(check->GetDialog(), check->GetChkBModifyNotification(),
                           &ZEP2DBaseOptGeoFrm::Write, nullptr);
  return _pChk[iSlot] = check;
}

ZEPDrwLockComboColor* ZEP2DBaseOptGeoFrm::ColorCombo(ZEPDialog* iFrame, const char* iName,
                                                     short iRow, short iColumn, short iWidth,
                                                     const ZEPSettingInfo& iInfo) {
  auto* combo = new ZEPDrwLockComboColor(iFrame, iName, iInfo);
  combo->SetGridConstraints(iRow, iColumn, iWidth, 1, 0x1E);
  if (ZEPComboColor* inner = combo->GetCombo()) {
    combo->SetVisibleTextWidth(8);
    // The colour combo itself is the sender the value transfer recognises.
    AddAnalyseNotificationCB(inner, inner->GetComboSelectNotification(), &ZEP2DBaseOptGeoFrm::Write,
                             nullptr);
  }
  return combo;
}

// A push button after an empty padlock column, so that it lines up with the lock-aware controls.
ZEPDlgPushButton* ZEP2DBaseOptGeoFrm::PushButton(ZEPDialog* iFrame, const char* iFrameName,
                                                 const char* iName, short iRow, short iWidth) {
  auto* frame = new ZEPDlgFrame(iFrame, iFrameName, 0x80001);
  frame->SetGridConstraints(iRow, 0, iWidth, 1, 0x1E);
  (new ZEPDrwLockLabel(frame, "invisibleLock1", 0))->SetGridConstraints(0, 0, 1, 1, 0x1E);
  auto* push = new ZEPDlgPushButton(frame, iName, 0);
  push->SetGridConstraints(0, 1, 1, 1, 0x1E);
  AddAnalyseNotificationCB(push, push->GetPushBActivateNotification(),
                           &ZEP2DBaseOptGeoFrm::NotifPush, nullptr);
  return push;
}

void ZEP2DBaseOptGeoFrm::Build() {
  ZEPSettingInfo info;

  _pGridFrame = CreateGridFrame();
  if (_pGridFrame) {
    _pGridFrame->SetGridConstraints(0, 0, 1, 1, 0x1E);
    _pGridFrame->Build();
  }

  ZEPDlgFrame* center = Section(this, "frameCenter", "I_SktSwitchStandard", 1);
  Check(center, kSlotCreateGeomCenter, "checkCenter", 0, 0, 3, info);
  Check(center, kSlotCreateEndPtsGenGeom, "chkEndPtsDuplGenGeom", 1, 0, 3, info);
  (new ZEPDrwLockLabel(center, "labelSmartPickColor", 1))->SetGridConstraints(2, 0, 1, 1, 0x1E);
  GetSysSmartPickInfo(info);
  _pCmbSmartPick = ColorCombo(center, "cmbSmartPick", 2, 1, 2, info);
  Check(center, kSlotShowHV, "chkShowHV", 3, 0, 4, info);
  Check(center, kSlotAllowGeomManip, "checkGeomDrag", 4, 0, 2, info);
  _pPushDragOption = new ZEPDlgPushButton(center, "dragOptionPushButton", 0);
  _pPushDragOption->SetGridConstraints(4, 2, 1, 1, 0x02);
  AddAnalyseNotificationCB(_pPushDragOption, _pPushDragOption->GetPushBActivateNotification(),
                           &ZEP2DBaseOptGeoFrm::NotifPush, nullptr);

  ZEPDlgFrame* creation = Section(this, "frameCstCreation", "I_D3M_CstCreation", 2);
  Check(creation, kSlotCreateCst, "checkCstCreation", 0, 0, 1, info);
  _pPushSmartPick = PushButton(creation, "framePushButton", "smartPickPushButton", 1, 1);

  ZEPDlgFrame* display = Section(this, "frameCstVisu", "I_D3M_CstVisu", 3);
  Check(display, kSlotDisplayCst, "checkCstVisu", 0, 0, 2, info);
  (new ZEPDrwLockLabel(display, "labelCstRefSize", 1))->SetGridConstraints(1, 0, 1, 1, 0x1E);
  GetSysRefSizeCstInfo(info);
  _pSpnRefSizeCst = new ZEPDrwLockSpinner(display, "editorCstRefSize", info, 0x60000);
  _pSpnRefSizeCst->SetGridConstraints(1, 1, 2, 1, 0x1E);
  _pSpnRefSizeCst->SetVisibleTextWidth(7);
  // A length on the sheet, shown in the paper length unit.
  Services::SetLengthUnitToDlgControl(_pSpnRefSizeCst->GetSpinner(), ZEPCkeScaleNormal, 1, 3, 0);
  Services::SetLengthMinMaxStep(_pSpnRefSizeCst->GetSpinner(), ZEPCkeScaleNormal, 1, 0.0, 100000.0,
                                1.0);
  AddAnalyseNotificationCB(_pSpnRefSizeCst->GetDialog(),
                           _pSpnRefSizeCst->GetSpinnerModifyNotification(),
                           &ZEP2DBaseOptGeoFrm::Write, nullptr);
  (new ZEPDrwLockLabel(display, "labelCstColor", 1))->SetGridConstraints(2, 0, 1, 1, 0x1E);
  GetSysColorCstInfo(info);
  _pCmbColorCst = ColorCombo(display, "comboCstColor", 2, 1, 1, info);
  _pPushCstTypes = PushButton(display, "frameCTPushButton", "cstTypesPushButton", 3, 3);

  ZEPDlgFrame* ditto = Section(this, "frameDittoInv", "I_D3M_Ditto", 4);
  Check(ditto, kSlotDittoWithFixSize, "DittoInvViewScale", 0, 0, 1, info);
  Check(ditto, kSlotDittoPreventManip, "DittoDrag", 1, 0, 1, info);
  Check(ditto, kSlotDittoPreventScale, "DittoScale", 2, 0, 1, info);
}

// ---- values -------------------------------------------------------------------------------------
void ZEP2DBaseOptGeoFrm::Initialize() {
  if (_pGridFrame) _pGridFrame->Initialize();
  for (int slot = 0; slot < kSlotCount; ++slot) {
    if (auto get = Hooks(slot).get) {
      (this->*get)(_bFlag[slot]);
      continue;
    }
    switch (slot) {
    case kSlotRefSizeCst:
      GetSysRefSizeCst(_dRefSizeCst);
      break;
    case kSlotColorCst:
      GetSysColorCst(_iColorCst[0], _iColorCst[1], _iColorCst[2]);
      break;
    case kSlotDragSolveMode:
      GetSysDragSolveMode(_iDragSolveMode);
      break;
    case kSlotSmartPick:
      GetSysSmartPick(_uSmartPick[0], _uSmartPick[1], _uSmartPick[2]);
      break;
    default:
      break;
    }
  }
  UpdateWidgets();
}

// Only the page's own controls: a sub-dialog shows its values when it is built.
void ZEP2DBaseOptGeoFrm::UpdateWidgets() {
  for (int slot :
       {kSlotCreateGeomCenter, kSlotAllowGeomManip, kSlotShowHV, kSlotCreateEndPtsGenGeom}) {
    Services::UpdateCheckButton(_pChk[slot], _bFlag[slot]);
    if (slot == kSlotAllowGeomManip) UpdateDragSensitivity();
  }
  Services::UpdateComboColor(_pCmbSmartPick, _uSmartPick[0], _uSmartPick[1], _uSmartPick[2]);
  Services::UpdateCheckButton(_pChk[kSlotCreateCst], _bFlag[kSlotCreateCst]);
  Services::UpdateCheckButton(_pChk[kSlotDisplayCst], _bFlag[kSlotDisplayCst]);
  UpdateCstVisuSensitivity();
  Services::UpdateSpinner(_pSpnRefSizeCst, _dRefSizeCst * 0.001);
  for (int slot : {kSlotDittoWithFixSize, kSlotDittoPreventManip, kSlotDittoPreventScale})
    Services::UpdateCheckButton(_pChk[slot], _bFlag[slot]);
  Services::UpdateComboColor(_pCmbColorCst, _iColorCst[0], _iColorCst[1], _iColorCst[2]);
}

// The drag options need direct manipulation.
void ZEP2DBaseOptGeoFrm::UpdateDragSensitivity() {
  if (_pPushDragOption) _pPushDragOption->SetSensitivity(Sensitivity(_bFlag[kSlotAllowGeomManip]));
}

// Reference size, colour and types of the constraints shown need their display.
void ZEP2DBaseOptGeoFrm::UpdateCstVisuSensitivity() {
  const unsigned long sensitivity = Sensitivity(_bFlag[kSlotDisplayCst]);
  if (_pSpnRefSizeCst) _pSpnRefSizeCst->SetSensitivity(sensitivity);
  if (_pCmbColorCst) _pCmbColorCst->SetSensitivity(sensitivity);
  if (_pPushCstTypes) _pPushCstTypes->SetSensitivity(sensitivity);
}

void ZEP2DBaseOptGeoFrm::Write(ZEPCommand* iSender, ZEPNotification*, void*) {
  // Check buttons, the page's and the sub-dialogs' alike.
  for (int slot = 0; slot < kSlotCount; ++slot) {
    if (!Hooks(slot).set ||
        Services::GetValueFromCheckButton(_pChk[slot], iSender, _bFlag[slot]) < 0)
      continue;
    (this->*Hooks(slot).set)(_bFlag[slot]);
    if (slot == kSlotAllowGeomManip) UpdateDragSensitivity();
    if (slot == kSlotDisplayCst) UpdateCstVisuSensitivity();
    return;
  }
  if (Services::GetValueFromSpinner(_pSpnRefSizeCst, iSender, 1000.0, _dRefSizeCst) >= 0) {
    SetSysRefSizeCst(_dRefSizeCst);
    return;
  }
  if (Services::GetValueFromComboColor(_pCmbColorCst, iSender, _iColorCst[0], _iColorCst[1],
                                       _iColorCst[2]) >= 0) {
    SetSysColorCst(_iColorCst[0], _iColorCst[1], _iColorCst[2]);
    return;
  }
  int rgb[3] = {0, 0, 0};
  if (Services::GetValueFromComboColor(_pCmbSmartPick, iSender, rgb[0], rgb[1], rgb[2]) >= 0) {
    for (int i = 0; i < 3; ++i)
      _uSmartPick[i] = static_cast<unsigned int>(rgb[i]);
    SetSysSmartPick(_uSmartPick[0], _uSmartPick[1], _uSmartPick[2]);
    return;
  }
  const bool radios = _pRadDragModeStd && _pRadDragModeMin && _pRadDragModeRel;
  if (radios &&
      (iSender == _pRadDragModeStd || iSender == _pRadDragModeMin || iSender == _pRadDragModeRel)) {
    // The mode follows the radios' states, whichever of them sent.
    int mode = 0;
    if (_pRadDragModeMin->GetState() == ZEPDlgChecked)
      mode = 1;
    else if (_pRadDragModeRel->GetState() == ZEPDlgChecked)
      mode = 2;
    if (mode == _iDragSolveMode) return;
    _iDragSolveMode = mode;
    SetSysDragSolveMode(_iDragSolveMode);
  }
}

// ---- sub-dialogs --------------------------------------------------------------------------------
void ZEP2DBaseOptGeoFrm::NotifPush(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (!iSender) return;
  if (iSender == _pPushDragOption)
    _dlgAllowGeomManip.Open(this, &ZEP2DBaseOptGeoFrm::BuildDlgAllowGeomManip,
                            &ZEP2DBaseOptGeoFrm::CloseDlg);
  else if (iSender == _pPushSmartPick)
    _dlgSmartPick.Open(this, &ZEP2DBaseOptGeoFrm::BuildDlgSmartPick, &ZEP2DBaseOptGeoFrm::CloseDlg);
  else if (iSender == _pPushCstTypes)
    _dlgTypeCst.Open(this, &ZEP2DBaseOptGeoFrm::BuildDlgTypeCst, &ZEP2DBaseOptGeoFrm::CloseDlg);
}

void ZEP2DBaseOptGeoFrm::CloseDlg(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (_dlgAllowGeomManip.Close(iSender) || _dlgSmartPick.Close(iSender)) return;
  _dlgTypeCst.Close(iSender);
}

void ZEP2DBaseOptGeoFrm::BuildDlgAllowGeomManip(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo) {
  ZEPDlgFrame* frame = Section(iDialog, "frameButtonDragElts", "I_Solving", 0);
  GetSysDragSolveModeInfo(ioInfo);
  auto* modes = new ZEPDrwLockFrame(frame, "frameDragMode", ioInfo, 1);
  modes->SetGridConstraints(0, 0, 1, 1, 0x1E);
  if (ZEPDialog* group = modes->GetDialog()) {
    ZEPDlgRadioButton** radios[] = {&_pRadDragModeStd, &_pRadDragModeMin, &_pRadDragModeRel};
    const char* names[] = {"radioDragModeStd", "radioDragModeMin", "radioDragModeRel"};
    for (short i = 0; i < 3; ++i) {
      auto* radio = *radios[i] = new ZEPDlgRadioButton(group, names[i], 0);
      radio->SetGridConstraints(i, 0, 1, 1, 0x1E);
      AddAnalyseNotificationCB(radio, radio->GetRadBModifyNotification(),
                               &ZEP2DBaseOptGeoFrm::Write, nullptr);
    }
  }
  Check(frame, kSlotDragWithEndPts, "checkDragWithEndPts", 1, 0, 1, ioInfo);
  if (_pRadDragModeStd && _pRadDragModeMin && _pRadDragModeRel) {
    ZEPDlgRadioButton* on = _iDragSolveMode == 2   ? _pRadDragModeRel
                            : _iDragSolveMode == 1 ? _pRadDragModeMin
                                                   : _pRadDragModeStd; // any other mode too
    on->SetState(ZEPDlgChecked, 0);
  }
  Services::UpdateCheckButton(_pChk[kSlotDragWithEndPts], _bFlag[kSlotDragWithEndPts]);
}

void ZEP2DBaseOptGeoFrm::BuildDlgSmartPick(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo) {
  static const DialogCheck checks[] = {
      {kSlotSmartPickCoincid, "checkSmartPickCoincid", 0, 0},
      {kSlotSmartPickAlign, "checkSmartPickAlign", 1, 0},
      {kSlotSmartPickParaPerpenTang, "checkSmartPickParaPerpenTang", 2, 0},
      {kSlotSmartPickHoriVerti, "checkSmartPickHoriVerti", 3, 0},
  };
  BuildChecks(Section(iDialog, "frameSmartPick", "I_ConstraintCopilot", 0), checks, ioInfo);
}

void ZEP2DBaseOptGeoFrm::BuildDlgTypeCst(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo) {
  static const DialogCheck checks[] = {
      {kSlotCstVisuHori, "checkCstVisuHori", 0, 0},     {kSlotCstVisuVerti, "checkCstVisuVerti", 0, 1},
      {kSlotCstVisuPara, "checkCstVisuPara", 1, 0},     {kSlotCstVisuPerpen, "checkCstVisuPerpen", 1, 1},
      {kSlotCstVisuConcen, "checkCstVisuConcen", 2, 0}, {kSlotCstVisuCoinci, "checkCstVisuCoinci", 2, 1},
      {kSlotCstVisuTangen, "checkCstVisuTangen", 3, 0}, {kSlotCstVisuSym, "checkCstVisuSym", 3, 1},
  };
  BuildChecks(Section(iDialog, "frameConstraintsTypes", "I_D3M_CstVisu", 0), checks, ioInfo);
}

// The check buttons of a dialog, each with its own info hook, then each showing its flag.
template <std::size_t N>
void ZEP2DBaseOptGeoFrm::BuildChecks(ZEPDialog* iFrame, const DialogCheck (&iChecks)[N], ZEPSettingInfo& ioInfo) {
  for (const DialogCheck& c : iChecks) Check(iFrame, c.slot, c.name, c.row, c.column, 1, ioInfo);
  for (const DialogCheck& c : iChecks) Services::UpdateCheckButton(_pChk[c.slot], _bFlag[c.slot]);
}
