#include "ZEP2DBasePrimaryViewFrm.h"

#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockLabel.h"
#include "ZEPDrwLockSpinner.h"
#include "ZEPDrwSettingsServices.h"

#define ZEP_SETTING(Name, Kind) ZEP_DEFINE_SETTING_HOOKS(ZEP2DBasePrimaryViewFrm, Name, Kind)
#include "ZEP2DBasePrimaryViewFrm.def"
#undef ZEP_SETTING

namespace {
using Services = ZEPDrwSettingsServices;
}

ZEP2DBasePrimaryViewFrm::ZEP2DBasePrimaryViewFrm(ZEPDialog* iParent)
    : ZEPDlgFrame(iParent, "PrimaryViewFrame", 0x80001) {}

ZEP2DBasePrimaryViewFrm::~ZEP2DBasePrimaryViewFrm() {
  _pChkChangePlane = _pChkResizeViewBox = _pChkGridLabels = nullptr;
  _pSpnDefaultOffset = nullptr;
}

ZEPString ZEP2DBasePrimaryViewFrm::GetResourceFilename(int iIndex) const {
  if (iIndex >= 1) return ZEPDlgFrame::GetResourceFilename(iIndex - 1);
  return "ZEP2DBasePrimaryViewFrm";
}

void ZEP2DBasePrimaryViewFrm::Build() {
  auto* section = new ZEPDlgToolsOptionsFrame(this, "toolPrimaryView", GetFrameIconName(), 4);
  section->SetGridConstraints(0, 0, 1, 1, 0x1E);
  SetGridColumnResizable(0, 1);
  ZEPDlgFrame* frame = section->GetOptionsFrame();
  ZEPSettingInfo info;
  short row = 0;
  auto check = [this, &info, frame](const char* iName, short iRow, short iColumn) {
    auto* c = new ZEPDrwLockCheckButton(frame, iName, info, 0);
    c->SetGridConstraints(iRow, iColumn, 3, 1, 0x1E);
    AddAnalyseNotificationCB(c->GetDialog(), c->GetChkBModifyNotification(), &ZEP2DBasePrimaryViewFrm::Write,
                             nullptr);
    return c;
  };

  // The offset row exists only when its info hook answers exactly 0.
  if (GetSysDefaultOffsetBetViewsInfo(info) == 0) {
    auto* label = new ZEPDrwLockLabel(frame, "pLblDefaultOffset", 1);
    label->SetGridConstraints(0, 0, 2, 1, 0x1E);
    _pSpnDefaultOffset = new ZEPDrwLockSpinner(frame, "spnDefaultOffsetBetViews", info, 0x60000);
    _pSpnDefaultOffset->SetGridConstraints(0, 2, 1, 1, 0x1E);
    _pSpnDefaultOffset->SetVisibleTextWidth(5);
    _pSpnDefaultOffset->SetLongHelp(label->GetLongHelp());
    // A length on the sheet: shown in the paper unit.
    Services::SetLengthUnitToDlgControl(_pSpnDefaultOffset->GetSpinner(), ZEPCkeScaleNormal, 1, 3, 0);
    Services::SetLengthMinMaxStep(_pSpnDefaultOffset->GetSpinner(), ZEPCkeScaleNormal, 1, 0.0, 10000.0, 10.0);
    AddAnalyseNotificationCB(_pSpnDefaultOffset->GetDialog(), _pSpnDefaultOffset->GetSpinnerModifyNotification(),
                             &ZEP2DBasePrimaryViewFrm::Write, nullptr);
    row = 1;
  }

  (new ZEPDrwLockLabel(frame, "RefElemSelLabel", 1))->SetGridConstraints(row++, 0, 4, 1, 0x1E);
  // A padlock-wide spacer indents the two checks under the caption.
  (new ZEPDrwLockLabel(frame, "invLbl", 0))->SetGridConstraints(row, 0, 1, 1, 0x1E);
  GetSysChangePrimaryViewPlaneInfo(info);
  _pChkChangePlane = check("chkChangePrimaryViewPlane", row++, 1);
  GetSysResizeViewBoxOn3DInfo(info);
  _pChkResizeViewBox = check("chkResizeViewBoxOn3D", row++, 1);
  if (GetSysManage3DGridLabelDisplayInfo(info) == 0) _pChkGridLabels = check("chkManage3DGridLabelDisplay", row, 0);
}

void ZEP2DBasePrimaryViewFrm::Initialize() {
  GetSysChangePrimaryViewPlane(_bChangePlane);
  GetSysResizeViewBoxOn3D(_bResizeViewBox);
  GetSysManage3DGridLabelDisplay(_bManageGridLabels);
  GetSysDefaultOffsetBetViews(_dDefaultOffset);
  UpdateWidgets();
}

void ZEP2DBasePrimaryViewFrm::UpdateWidgets() {
  Services::UpdateCheckButton(_pChkChangePlane, _bChangePlane);
  Services::UpdateCheckButton(_pChkResizeViewBox, _bResizeViewBox);
  Services::UpdateCheckButton(_pChkGridLabels, _bManageGridLabels);
  Services::UpdateSpinner(_pSpnDefaultOffset, _dDefaultOffset * 0.001);
}

void ZEP2DBasePrimaryViewFrm::Write(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (Services::GetValueFromCheckButton(_pChkChangePlane, iSender, _bChangePlane) >= 0)
    SetSysChangePrimaryViewPlane(_bChangePlane);
  else if (Services::GetValueFromCheckButton(_pChkResizeViewBox, iSender, _bResizeViewBox) >= 0)
    SetSysResizeViewBoxOn3D(_bResizeViewBox);
  else if (Services::GetValueFromCheckButton(_pChkGridLabels, iSender, _bManageGridLabels) >= 0)
    SetSysManage3DGridLabelDisplay(_bManageGridLabels);
  else if (Services::GetValueFromSpinner(_pSpnDefaultOffset, iSender, 1000.0, _dDefaultOffset) >= 0)
    SetSysDefaultOffsetBetViews(_dDefaultOffset);
}
