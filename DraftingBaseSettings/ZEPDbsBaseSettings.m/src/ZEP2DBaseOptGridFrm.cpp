#include "ZEP2DBaseOptGridFrm.h"

#include "ZEP2DBaseRangeCmb.h"
#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockLabel.h"
#include "ZEPDrwLockSpinner.h"
#include "ZEPDrwSettingsServices.h"

#include <climits>
#include <cmath>

#define ZEP_SETTING(Name, Kind) ZEP_DEFINE_SETTING_HOOKS(ZEP2DBaseOptGridFrm, Name, Kind)
#include "ZEP2DBaseOptGridFrm.def"
#undef ZEP_SETTING

namespace {
using Services = ZEPDrwSettingsServices;

// Spinner values are metres, the settings millimetres.
const double kToMetres = 0.001;
const double kToMillimetres = 1000.0;
// Horizontal spacing limit in millimetres; the vertical one is ten times smaller.
const double kMaxSpacingH = 100000.0;
const double kMaxSpacingV = 10000.0;
const double kSpacingStep = 5.0;

// A graduation count as typed: truncated toward zero, kept within the int range.
int Truncate(double iValue) {
  if (!(iValue == iValue)) return 0;
  if (iValue >= static_cast<double>(INT_MAX)) return INT_MAX;
  if (iValue <= static_cast<double>(INT_MIN)) return INT_MIN;
  return static_cast<int>(std::trunc(iValue));
}
} // namespace

ZEP2DBaseOptGridFrm::ZEP2DBaseOptGridFrm(ZEPDialog* iParent, const ZEPString& iName)
    : ZEPDlgFrame(iParent, iName, 0x80001) {
  // 100 mm at each range, scaled by the range's length factor.
  const double spacing[kRangeCount] = {100.0, 10000.0, 1000000.0, 1.0, 0.01};
  for (int i = 0; i < kRangeCount; ++i) {
    _dPrimSpaceH[i] = _dPrimSpaceV[i] = spacing[i];
    _iGradH[i] = _iGradV[i] = 10;
    _bAllowDistortions[i] = 0;
  }
}

ZEP2DBaseOptGridFrm::~ZEP2DBaseOptGridFrm() {
  _pChkGrid = _pChkSnap = _pChkDistortions = nullptr;
  _pSpnSpacingH = _pSpnGraduationH = _pSpnSpacingV = _pSpnGraduationV = nullptr;
  _pRangeCmb = nullptr;
}

ZEPString ZEP2DBaseOptGridFrm::GetResourceFilename(int iIndex) const {
  if (iIndex >= 1) return ZEPDlgFrame::GetResourceFilename(iIndex - 1);
  return "ZEP2DBaseOptGridFrm";
}

void ZEP2DBaseOptGridFrm::Build() {
  ZEPSettingInfo info;
  auto* section = new ZEPDlgToolsOptionsFrame(this, "frameGrid", "I_DisplayGrid", 4);
  section->SetGridConstraints(0, 0, 1, 1, 0x1E);
  ZEPDlgFrame* frame = section->GetOptionsFrame();

  // Without a snap setting the grid check takes the snap check's row.
  const bool withSnap = GetSysSnapToPointInfo(info) == 0;
  GetSysDisplayGridInfo(info);
  _pChkGrid = new ZEPDrwLockCheckButton(frame, "checkGrid", info, 0);
  _pChkGrid->SetGridConstraints(withSnap ? 0 : 1, 0, 1, 1, 0x1E);
  AddAnalyseNotificationCB(_pChkGrid->GetDialog(), _pChkGrid->GetChkBModifyNotification(),
                           &ZEP2DBaseOptGridFrm::Write, nullptr);
  if (withSnap) {
    GetSysSnapToPointInfo(info);
    _pChkSnap = new ZEPDrwLockCheckButton(frame, "checkSnap", info, 0);
    _pChkSnap->SetGridConstraints(1, 0, 1, 1, 0x1E);
    AddAnalyseNotificationCB(_pChkSnap->GetDialog(), _pChkSnap->GetChkBModifyNotification(),
                             &ZEP2DBaseOptGridFrm::Write, nullptr);
  }

  auto* lblSpacing = new ZEPDrwLockLabel(frame, "labelGridSpacing", 1);
  lblSpacing->SetGridConstraints(0, 2, 1, 1, 0x1E);
  auto* lblGraduation = new ZEPDrwLockLabel(frame, "labelGridGraduation", 1);
  lblGraduation->SetGridConstraints(0, 3, 1, 1, 0x1E);
  (new ZEPDrwLockLabel(frame, "labelH", 1))->SetGridConstraints(1, 1, 1, 1, 0x1E);
  (new ZEPDrwLockLabel(frame, "labelV", 1))->SetGridConstraints(2, 1, 1, 1, 0x1E);

  // One spacing and one graduation spinner per direction, on rows 1 and 2.
  auto makeSpacing = [&](const char* iName, short iRow) {
    auto* spinner = new ZEPDrwLockSpinner(frame, iName, info, 0x60000);
    spinner->SetGridConstraints(iRow, 2, 1, 1, 0x1E);
    spinner->SetVisibleTextWidth(5);
    spinner->SetLongHelp(lblSpacing->GetLongHelp());
    AddAnalyseNotificationCB(spinner->GetDialog(), spinner->GetSpinnerModifyNotification(),
                             &ZEP2DBaseOptGridFrm::Write, nullptr);
    return spinner;
  };
  auto makeGraduation = [&](const char* iName, short iRow) {
    auto* spinner = new ZEPDrwLockSpinner(frame, iName, info, 0x40000);
    spinner->SetGridConstraints(iRow, 3, 1, 1, 0x1E);
    spinner->SetVisibleTextWidth(5);
    spinner->SetFormat("%g");
    spinner->SetRange(1.0f, 100000.0f, 99999);
    spinner->SetLongHelp(lblGraduation->GetLongHelp());
    AddAnalyseNotificationCB(spinner->GetDialog(), spinner->GetSpinnerModifyNotification(),
                             &ZEP2DBaseOptGridFrm::Write, nullptr);
    return spinner;
  };

  GetSysPrimSpaceHInfo(info);
  _pSpnSpacingH = makeSpacing("editorGridSpacing", 1);
  GetSysGradHInfo(info);
  _pSpnGraduationH = makeGraduation("editorGridGraduation", 1);

  GetSysAllowDistortionsInfo(info);
  _pChkDistortions = new ZEPDrwLockCheckButton(frame, "checkAllowDistortions", info, 0);
  _pChkDistortions->SetGridConstraints(2, 0, 1, 1, 0x1E);
  AddAnalyseNotificationCB(_pChkDistortions->GetDialog(), _pChkDistortions->GetChkBModifyNotification(),
                           &ZEP2DBaseOptGridFrm::Write, nullptr);

  GetSysPrimSpaceVInfo(info);
  _pSpnSpacingV = makeSpacing("editorGridSpacingV", 2);
  GetSysGradVInfo(info);
  _pSpnGraduationV = makeGraduation("editorGridGraduationV", 2);

  // The range combo spans both rows and carries no padlock.
  _pRangeCmb = new ZEP2DBaseRangeCmb(frame, "cmbGridRange");
  _pRangeCmb->SetGridConstraints(1, 4, 1, 2, 0x7E);
  AddAnalyseNotificationCB(_pRangeCmb, _pRangeCmb->GetComboSelectNotification(), &ZEP2DBaseOptGridFrm::Write,
                           nullptr);
}

void ZEP2DBaseOptGridFrm::Initialize() {
  GetSysDisplayGrid(_bDisplayGrid);
  GetSysSnapToPoint(_bSnapToPoint);
  GetSysAllowDistortions(_bAllowDistortions, kRangeCount);
  GetSysPrimSpaceH(_dPrimSpaceH, kRangeCount);
  GetSysPrimSpaceV(_dPrimSpaceV, kRangeCount);
  GetSysGradH(_iGradH, kRangeCount);
  GetSysGradV(_iGradV, kRangeCount);
  // Without a scales service the combo answers -1: the page keeps the range it shows.
  if (_pRangeCmb) {
    int range = _pRangeCmb->GetSelect();
    if (range >= 1 && range <= kRangeCount) _currentRange = range;
  }
  UpdateWidgets();
}

void ZEP2DBaseOptGridFrm::UpdateWidgets() {
  Services::UpdateCheckButton(_pChkGrid, _bDisplayGrid);
  Services::UpdateCheckButton(_pChkSnap, _bSnapToPoint);
  UpdateGridValues();
}

void ZEP2DBaseOptGridFrm::UpdateGridValues() {
  const int i = Index();
  const ZEPCkeScale scale = ZEP2DBaseRangeCmb::GetMatchingRange(_currentRange);
  const bool distorted = _bAllowDistortions[i] != 0;

  Services::UpdateCheckButton(_pChkDistortions, _bAllowDistortions[i]);
  if (_pSpnSpacingV) _pSpnSpacingV->SetSensitivity(distorted ? ZEPDlgEnable : ZEPDlgDisable);
  if (_pSpnGraduationV) _pSpnGraduationV->SetSensitivity(distorted ? ZEPDlgEnable : ZEPDlgDisable);

  // Units and limits follow the range shown.
  auto showSpacing = [scale](ZEPDrwLockSpinner* iSpinner, double iMax, double iValue) {
    if (!iSpinner) return;
    ZEPDlgSpinner* inner = iSpinner->GetSpinner();
    Services::SetLengthUnitToDlgControl(inner, scale, 0, 3, 0);
    Services::SetLengthMinMaxStep(inner, scale, 0, 0.0, iMax, kSpacingStep);
    Services::UpdateSpinner(iSpinner, iValue * kToMetres);
  };
  showSpacing(_pSpnSpacingH, kMaxSpacingH, _dPrimSpaceH[i]);
  showSpacing(_pSpnSpacingV, kMaxSpacingV, distorted ? _dPrimSpaceV[i] : _dPrimSpaceH[i]);
  if (_pSpnGraduationH) _pSpnGraduationH->SetCurrentValue(static_cast<float>(_iGradH[i]), 0);
  if (_pSpnGraduationV)
    _pSpnGraduationV->SetCurrentValue(static_cast<float>(distorted ? _iGradV[i] : _iGradH[i]), 0);
}

void ZEP2DBaseOptGridFrm::Write(ZEPCommand* iSender, ZEPNotification*, void*) {
  const int i = Index();

  if (Services::GetValueFromCheckButton(_pChkGrid, iSender, _bDisplayGrid) == S_OK) {
    SetSysDisplayGrid(_bDisplayGrid);
    return;
  }
  if (Services::GetValueFromCheckButton(_pChkSnap, iSender, _bSnapToPoint) == S_OK) {
    SetSysSnapToPoint(_bSnapToPoint);
    return;
  }
  if (Services::GetValueFromSpinner(_pSpnSpacingH, iSender, kToMillimetres, _dPrimSpaceH[i]) == S_OK) {
    SetSysPrimSpaceH(_dPrimSpaceH, kRangeCount);
    // Without distortion the vertical spinner mirrors the horizontal one (not written).
    if (!_bAllowDistortions[i] && _pSpnSpacingV) _pSpnSpacingV->SetValue(_dPrimSpaceH[i] * kToMetres, 1);
    return;
  }
  if (_pSpnGraduationH && iSender && iSender == _pSpnGraduationH->GetDialog()) {
    const int n = Truncate(_pSpnGraduationH->GetCurrentValue());
    if (n != _iGradH[i]) {
      _iGradH[i] = n;
      _pSpnGraduationH->SetCurrentValue(static_cast<float>(n), 0);
      SetSysGradH(_iGradH, kRangeCount);
    }
    if (!_bAllowDistortions[i] && _pSpnGraduationV && Truncate(_pSpnGraduationV->GetCurrentValue()) != _iGradH[i])
      _pSpnGraduationV->SetCurrentValue(static_cast<float>(_iGradH[i]), 1);
    return;
  }
  if (Services::GetValueFromCheckButton(_pChkDistortions, iSender, _bAllowDistortions[i]) == S_OK) {
    SetSysAllowDistortions(_bAllowDistortions, kRangeCount);
    const bool distorted = _bAllowDistortions[i] != 0;
    if (_pSpnSpacingV) _pSpnSpacingV->SetSensitivity(distorted ? ZEPDlgEnable : ZEPDlgDisable);
    if (_pSpnGraduationV) _pSpnGraduationV->SetSensitivity(distorted ? ZEPDlgEnable : ZEPDlgDisable);
    // Turned off: the vertical controls show the horizontal values again.
    if (!distorted) {
      if (_pSpnSpacingV) _pSpnSpacingV->SetValue(_dPrimSpaceH[i] * kToMetres, 1);
      if (_pSpnGraduationV) _pSpnGraduationV->SetCurrentValue(static_cast<float>(_iGradH[i]), 1);
    }
    return;
  }
  if (Services::GetValueFromSpinner(_pSpnSpacingV, iSender, kToMillimetres, _dPrimSpaceV[i]) == S_OK) {
    SetSysPrimSpaceV(_dPrimSpaceV, kRangeCount);
    return;
  }
  if (_pSpnGraduationV && iSender && iSender == _pSpnGraduationV->GetDialog()) {
    const int n = Truncate(_pSpnGraduationV->GetCurrentValue());
    if (n == _iGradV[i]) return;
    _iGradV[i] = n;
    _pSpnGraduationV->SetCurrentValue(static_cast<float>(n), 0);
    SetSysGradV(_iGradV, kRangeCount);
    return;
  }
  if (_pRangeCmb && iSender == _pRangeCmb) {
    const int range = _pRangeCmb->GetSelect();
    if (range >= 1 && range <= kRangeCount) _currentRange = range;
    UpdateGridValues();
  }
}
