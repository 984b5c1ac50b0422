#include "ZEP2DBaseOptGalFrm.h"

#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockCombo.h"
#include "ZEPDrwLockLabel.h"
#include "ZEPDrwLockSpinner.h"
#include "ZEPDrwSettingsServices.h"

#define ZEP_SETTING(Name, Kind) ZEP_DEFINE_SETTING_HOOKS(ZEP2DBaseOptGalFrm, Name, Kind)
#include "ZEP2DBaseOptGalFrm.def"
#undef ZEP_SETTING

namespace {
using Services = ZEPDrwSettingsServices;

// Paper length unit codes by line of the unit combo: millimetre, centimetre, inch.
const int kUnitCodes[] = {1, 3, 5};
const char* const kUnitKeys[] = {"mmUnit", "cmUnit", "inUnit"};
const int kUnitCount = 3;
} // namespace

ZEP2DBaseOptGalFrm::ZEP2DBaseOptGalFrm(ZEPDialog* iParent, const ZEPString& iName)
    : ZEPDlgFrame(iParent, iName, 0x80001) {}

ZEP2DBaseOptGalFrm::~ZEP2DBaseOptGalFrm() {
  _pChkCopyFirstSheetBckg = _pChkViewFrame = _pChkViewReferential = _pChkViewRefZoom = nullptr;
  _pSpnViewAxisSize = nullptr;
  _pCmbPaperLengthUnit = nullptr;
}

ZEPString ZEP2DBaseOptGalFrm::GetResourceFilename(int iIndex) const {
  if (iIndex >= 1) return ZEPDlgFrame::GetResourceFilename(iIndex - 1);
  return "ZEP2DBaseOptGalFrm";
}

void ZEP2DBaseOptGalFrm::Build() {
  ZEPSettingInfo info;
  auto section = [this](const char* iName, const char* iIcon, short iRow) {
    auto* s = new ZEPDlgToolsOptionsFrame(this, iName, iIcon, *iIcon ? 4 : 6);
    s->SetGridConstraints(iRow, 0, 1, 1, 0x1E);
    return s->GetOptionsFrame();
  };
  auto check = [this, &info](ZEPDialog* iFrame, const char* iName, short iColumn, short iWidth) {
    auto* c = new ZEPDrwLockCheckButton(iFrame, iName, info, 0);
    c->SetGridConstraints(0, iColumn, iWidth, 1, 0x1E);
    AddAnalyseNotificationCB(c->GetDialog(), c->GetChkBModifyNotification(), &ZEP2DBaseOptGalFrm::Write, nullptr);
    return c;
  };

  ZEPDlgFrame* sheet = section("frameSheet", "I_D3M_Sheet", 0);
  GetSysCopyFirstSheetBckgInfo(info);
  _pChkCopyFirstSheetBckg = check(sheet, "chkCopyFirstSheetBckg", 0, 2);

  ZEPDlgFrame* view = section("frameView", "I_D3M_View", 1);
  GetSysViewFrameInfo(info);
  _pChkViewFrame = check(view, "checkViewFrame", 0, 2);

  ZEPDlgFrame* referential = section("frameViewReferential", "I_DisplayViewReferential", 2);
  GetSys2DAxisDisplayInfo(info);
  _pChkViewReferential = check(referential, "checkViewReferential", 0, 2);
  GetSys2DAxisZoomInfo(info);
  _pChkViewRefZoom = check(referential, "checkViewRefZoom", 2, 1);
  (new ZEPDrwLockLabel(referential, "labelViewAxisSize", 1))->SetGridConstraints(1, 0, 1, 1, 0x1E);
  GetSys2DAxisLengthInfo(info);
  _pSpnViewAxisSize = new ZEPDrwLockSpinner(referential, "spinnerViewAxisSize", info, 0x60000);
  _pSpnViewAxisSize->SetGridConstraints(1, 1, 1, 1, 0x1E);
  _pSpnViewAxisSize->SetVisibleTextWidth(5);
  Services::SetLengthUnitToDlgControl(_pSpnViewAxisSize->GetSpinner(), ZEPCkeScaleNormal, 0, 3, 0);
  Services::SetLengthMinMaxStep(_pSpnViewAxisSize->GetSpinner(), ZEPCkeScaleNormal, 0, 0.0, 100000.0, 5.0);
  AddAnalyseNotificationCB(_pSpnViewAxisSize->GetDialog(), _pSpnViewAxisSize->GetSpinnerModifyNotification(),
                           &ZEP2DBaseOptGalFrm::Write, nullptr);

  // Row 3 stays empty.
  ZEPDlgFrame* units = section("frmDrwUnits", "", 4);
  (new ZEPDrwLockLabel(units, "lblPaperLengthUnit", 1))->SetGridConstraints(0, 0, 1, 1, 0x1E);
  GetSysPaperLengthUnitInfo(info);
  _pCmbPaperLengthUnit = new ZEPDrwLockCombo(units, "cmbPaperLengthUnit", info, 0x40000);
  _pCmbPaperLengthUnit->SetGridConstraints(0, 2, 1, 1, 0x1E);
  if (ZEPDlgCombo* combo = _pCmbPaperLengthUnit->GetCombo())
    AddAnalyseNotificationCB(combo, combo->GetComboSelectNotification(), &ZEP2DBaseOptGalFrm::Write, nullptr);
}

void ZEP2DBaseOptGalFrm::Initialize() {
  GetSysCopyFirstSheetBckg(_bCopyFirstSheetBckg);
  GetSysViewFrame(_bViewFrame);
  GetSys2DAxisDisplay(_b2DAxisDisplay);
  GetSys2DAxisZoom(_b2DAxisZoom);
  GetSys2DAxisLength(_d2DAxisLength);
  GetSysPaperLengthUnit(_iPaperLengthUnit);
  UpdateWidgets();
}

void ZEP2DBaseOptGalFrm::UpdateWidgets() {
  Services::UpdateCheckButton(_pChkCopyFirstSheetBckg, _bCopyFirstSheetBckg);
  Services::UpdateCheckButton(_pChkViewFrame, _bViewFrame);
  Services::UpdateCheckButton(_pChkViewReferential, _b2DAxisDisplay);
  Services::UpdateCheckButton(_pChkViewRefZoom, _b2DAxisZoom);
  Services::UpdateSpinner(_pSpnViewAxisSize, _d2DAxisLength * 0.001);

  ZEPDlgCombo* combo = _pCmbPaperLengthUnit ? _pCmbPaperLengthUnit->GetCombo() : nullptr;
  if (!combo) return;
  combo->ClearLine();
  int line = 0;
  for (int i = 0; i < kUnitCount; ++i) {
    combo->SetLine(ZEPMsgCatalog::BuildMessage("ZEP2DBaseOptGalFrm", kUnitKeys[i], nullptr, 0, ZEPUnicodeString()),
                   -1, 0x40);
    if (kUnitCodes[i] == _iPaperLengthUnit) line = i;
  }
  combo->SetSelect(line, 0);
}

void ZEP2DBaseOptGalFrm::Write(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (Services::GetValueFromCheckButton(_pChkCopyFirstSheetBckg, iSender, _bCopyFirstSheetBckg) >= 0) {
    SetSysCopyFirstSheetBckg(_bCopyFirstSheetBckg);
  } else if (Services::GetValueFromCheckButton(_pChkViewFrame, iSender, _bViewFrame) >= 0) {
    SetSysViewFrame(_bViewFrame);
  } else if (Services::GetValueFromCheckButton(_pChkViewReferential, iSender, _b2DAxisDisplay) >= 0) {
    SetSys2DAxisDisplay(_b2DAxisDisplay);
  } else if (Services::GetValueFromCheckButton(_pChkViewRefZoom, iSender, _b2DAxisZoom) >= 0) {
    SetSys2DAxisZoom(_b2DAxisZoom);
  } else if (Services::GetValueFromSpinner(_pSpnViewAxisSize, iSender, 1000.0, _d2DAxisLength) >= 0) {
    SetSys2DAxisLength(_d2DAxisLength);
  } else {
    int line = -1;
    if (Services::GetValueFromCombo(_pCmbPaperLengthUnit, iSender, line) < 0) return;
    _iPaperLengthUnit = (line >= 0 && line < kUnitCount) ? kUnitCodes[line] : line;
    SetSysPaperLengthUnit(_iPaperLengthUnit);
  }
}
