#include "ZEP2DBaseOptDimFrm.h"

#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockFrame.h"
#include "ZEPDrwLockLabel.h"
#include "ZEPDrwLockSpinner.h"
#include "ZEPDrwSettingsServices.h"

#define ZEP_SETTING(Name, Kind) ZEP_DEFINE_SETTING_HOOKS(ZEP2DBaseOptDimFrm, Name, Kind)
#include "ZEP2DBaseOptDimFrm.def"
#undef ZEP_SETTING

namespace {
using Services = ZEPDrwSettingsServices;

// The hooks hold millimetres and degrees, the spinners metres and radians.
const double kToMetres = 0.001;
const double kToMillimetres = 1000.0;
const double kToRadians = 0.017453292519943393;
// Slightly below 180/pi: pi/4 radians are written as 44.99999999999975 degrees.
const double kToDegrees = 57.295779513082;

const unsigned int kCell = 0x1E;

// Values of DimCreateCircle and DimAssoc3DMod.
const int kCircleFromEdge = 1;
const int kForce2DAlways = 2;
const int kForce2DWhenProblem = 1;
const int kForce2DNever = 0;

bool IsChecked(const ZEPDlgRadioButton* iRadio) { return iRadio->GetState() == ZEPDlgChecked; }
} // namespace

// ---- Object model ---------------------------------------------------------------------------
const ZEPMetaObject* ZEP2DBaseOptDimFrm::_pMetaObject = nullptr;

const ZEPMetaObject* ZEP2DBaseOptDimFrm::MetaObject() {
  if (!_pMetaObject)
    _pMetaObject =
        fct_RetrieveMetaObject("ZEP2DBaseOptDimFrm", ZEPDlgFrame::MetaObject(), "ZEPNull",
                               "DraftingBaseSettings", &ZEP2DBaseOptDimFrm::CreateItself);
  return _pMetaObject;
}

const ZEPMetaObject* ZEP2DBaseOptDimFrm::GetMetaObject() const { return MetaObject(); }
const char* ZEP2DBaseOptDimFrm::ClassId() { return MetaObject()->ClassId(); }
const char* ZEP2DBaseOptDimFrm::ClassName() { return MetaObject()->GetName(); }
ZEPBaseUnknown* ZEP2DBaseOptDimFrm::CreateItself() { return nullptr; }

// ---- Life cycle -----------------------------------------------------------------------------
ZEP2DBaseOptDimFrm::ZEP2DBaseOptDimFrm(ZEPDialog* iParent, const ZEPString& iName)
    : ZEPDlgFrame(iParent, iName, 0x80001) {
  _dlgAssoc3D.Track(_pRadForce2DAlways, _pRadForce2DWhenPb, _pRadForce2DNever,
                    _pChkAssocDimOnApproximate);
}

// The toolkit owns the controls through the parent chain: only forget them.
ZEP2DBaseOptDimFrm::~ZEP2DBaseOptDimFrm() {
  _pChkDimSketch = _pChkDimLinePosRelative = _pChkDimDriveAuto = _pChkDetectChamfer = nullptr;
  _pChkActivateSnapBetSymbols = _pChkMoveSubPart = nullptr;
  _pChkLineUpStackVal = _pChkLineUpCumulVal = _pChkLineUpAutoFunnel = _pChkDimOriginSymb = nullptr;
  _pSpnDimLinePosValue = _pSpnBaseOffsetLength = _pSpnBaseOffsetAngle = nullptr;
  _pSpnOffsetLength = _pSpnOffsetAngle = nullptr;
  _pPushAssoc3D = nullptr;
  _pRadCircleCenter = _pRadCircleEdge = nullptr;
  _pRadForce2DAlways = _pRadForce2DWhenPb = _pRadForce2DNever = nullptr;
  _pChkAssocDimOnApproximate = nullptr;
}

ZEPString ZEP2DBaseOptDimFrm::GetResourceFilename(int iIndex) const {
  if (iIndex >= 1) return ZEPDlgFrame::GetResourceFilename(iIndex - 1);
  return "ZEP2DBaseOptDimFrm";
}

unsigned char ZEP2DBaseOptDimFrm::WithFrmCreateDriveAndChamfer() { return 1; }
unsigned char ZEP2DBaseOptDimFrm::WithLineUpValues() { return 1; }
unsigned char ZEP2DBaseOptDimFrm::WithFrmDimOrigin() { return 0; }

// ---- Build ----------------------------------------------------------------------------------
void ZEP2DBaseOptDimFrm::Build() {
  ZEPSettingInfo info;
  short pageRow = 0; // each section takes the next page row
  auto section = [this, &pageRow](const char* iName, const char* iIcon) {
    auto* s = new ZEPDlgToolsOptionsFrame(this, iName, iIcon, 4);
    s->SetGridConstraints(pageRow++, 0, 1, 1, kCell);
    return s->GetOptionsFrame();
  };
  auto frame = [](ZEPDialog* iParent, const char* iName, short iRow, short iColumn,
                  short iWidth = 1) {
    auto* f = new ZEPDlgFrame(iParent, iName, 0x80001);
    f->SetGridConstraints(iRow, iColumn, iWidth, 1, kCell);
    return f;
  };
  auto label = [](ZEPDialog* iParent, const char* iName, int iWithText, short iRow, short iColumn,
                  short iWidth = 1) {
    auto* l = new ZEPDrwLockLabel(iParent, iName, iWithText);
    l->SetGridConstraints(iRow, iColumn, iWidth, 1, kCell);
    return l;
  };
  auto check = [this, &info](ZEPDialog* iParent, const char* iName, short iRow, short iColumn,
                             short iWidth = 1) {
    auto* c = new ZEPDrwLockCheckButton(iParent, iName, info, 0);
    c->SetGridConstraints(iRow, iColumn, iWidth, 1, kCell);
    AddAnalyseNotificationCB(c->GetDialog(), c->GetChkBModifyNotification(),
                             &ZEP2DBaseOptDimFrm::Write, nullptr);
    return c;
  };
  auto spinner = [this, &info](ZEPDialog* iParent, const char* iName, short iRow, short iColumn,
                               int iWidth) {
    auto* s = new ZEPDrwLockSpinner(iParent, iName, info, 0x60000);
    s->SetGridConstraints(iRow, iColumn, 1, 1, kCell);
    s->SetVisibleTextWidth(iWidth);
    AddAnalyseNotificationCB(s->GetDialog(), s->GetSpinnerModifyNotification(),
                             &ZEP2DBaseOptDimFrm::Write, nullptr);
    return s;
  };
  // Lengths are paper lengths in millimetres, angles degrees.
  auto lengthSpinner = [&](ZEPDialog* iParent, const char* iName, short iRow, short iColumn,
                           int iWidth) {
    ZEPDrwLockSpinner* s = spinner(iParent, iName, iRow, iColumn, iWidth);
    Services::SetLengthUnitToDlgControl(s->GetSpinner(), ZEPCkeScaleNormal, 1, 3, 0);
    Services::SetLengthMinMaxStep(s->GetSpinner(), ZEPCkeScaleNormal, 1, -1000.0, 1000.0, 1.0);
    return s;
  };
  auto angleSpinner = [&](ZEPDialog* iParent, const char* iName, short iRow, short iColumn,
                          int iWidth) {
    ZEPDrwLockSpinner* s = spinner(iParent, iName, iRow, iColumn, iWidth);
    Services::SetAngleUnitToDlgControl(s->GetSpinner(), 3, 0);
    Services::SetAngleMinMaxStep(s->GetSpinner(), -180.0, 180.0, 5.0);
    return s;
  };
  auto radio = [this](ZEPDialog* iParent, const char* iName, short iRow, short iColumn) {
    auto* r = new ZEPDlgRadioButton(iParent, iName, 0);
    r->SetGridConstraints(iRow, iColumn, 1, 1, kCell);
    AddAnalyseNotificationCB(r, r->GetRadBModifyNotification(), &ZEP2DBaseOptDimFrm::Write,
                             nullptr);
    return r;
  };

  // Creation: following the cursor, line position, 3D associativity, drive and chamfer, circles.
  ZEPDlgFrame* sketch = section("frameDimSketch", "I_D3M_Dim");
  GetSysDimFollowMouseInfo(info);
  _pChkDimSketch = check(sketch, "checkDimSketch", 0, 0);

  GetSysDimConstantOffsetValueInfo(info);
  ZEPDlgFrame* linePos = frame(sketch, "frameLinePosValue", 1, 0);
  label(linePos, "invLock2", 0, 0, 0);
  ZEPDrwLockLabel* linePosLabel = label(linePos, "labelDimLinePosValue", 1, 0, 1);
  _pSpnDimLinePosValue = lengthSpinner(linePos, "editorDimLinePosValue", 0, 2, 5);
  _pSpnDimLinePosValue->SetLongHelp(linePosLabel->GetLongHelp());

  GetSysDimConstantOffsetInfo(info);
  _pChkDimLinePosRelative = check(sketch, "checkDimLinePosRelative", 2, 0);

  // The 3D associativity button only for a host that knows the setting.
  if (GetSysDimAssoc3DModInfo(info) >= 0) {
    ZEPDlgFrame* assoc = frame(sketch, "frameDimAssoc3D", 3, 0);
    label(assoc, "invLock1", 0, 0, 0);
    _pPushAssoc3D = new ZEPDlgPushButton(assoc, "pushAssoc3D", 0);
    _pPushAssoc3D->SetGridConstraints(0, 1, 1, 1, kCell);
    AddAnalyseNotificationCB(_pPushAssoc3D, _pPushAssoc3D->GetPushBActivateNotification(),
                             &ZEP2DBaseOptDimFrm::NotifPush, nullptr);
  }

  if (WithFrmCreateDriveAndChamfer()) {
    ZEPDlgFrame* driveAndChamfer = frame(sketch, "frm", 4, 0);
    GetSysDimCreateDriveInfo(info);
    _pChkDimDriveAuto = check(driveAndChamfer, "checkDimDriveAuto", 0, 0);
    GetSysDimDetectChamferInfo(info);
    _pChkDetectChamfer = check(driveAndChamfer, "chkDetectChamfer", 0, 1);
  }

  GetSysDimCreateCircleInfo(info);
  ZEPDlgFrame* circle = frame(sketch, "_frameDimCircle", 5, 0);
  label(circle, "_labelDimCircle", 1, 0, 0, 2);
  label(circle, "lblInv", 0, 1, 0);
  auto* circleLock = new ZEPDrwLockFrame(circle, "_frameDimCircleRadio", info, 0x80001);
  circleLock->SetGridConstraints(1, 1, 1, 1, kCell);
  if (ZEPDialog* radios = circleLock->GetDialog()) {
    _pRadCircleCenter = radio(radios, "_radioDimCircleCenter", 0, 0);
    _pRadCircleEdge = radio(radios, "_radioDimCircleEdge", 0, 1);
  }

  // Moving: snapping between symbols, moving sub-parts.
  ZEPDlgFrame* move = section("_frameMove", "I_D3M_Select");
  GetSysDimActivateSnapBetSymbolsInfo(info);
  _pChkActivateSnapBetSymbols = check(move, "chkDimActivateSnapBetSymbols", 0, 0);
  GetSysDimMoveSubPartInfo(info);
  _pChkMoveSubPart = check(move, "_checkDimMoveSubPart", 1, 0);

  // Lining up: offsets, stacked and cumulated values, the automatic funnel.
  ZEPDlgFrame* lineUp = section("_frameLineUp", "I_D3M_LineUp");
  if (WithLineUpValues()) {
    label(lineUp, "_labelLineUpBaseOffset", 1, 0, 0);
    GetSysDimOffsetRefMMInfo(info);
    _pSpnBaseOffsetLength = lengthSpinner(lineUp, "_editorLineUpBaseOffsetLength", 0, 1, 4);
    GetSysDimOffsetRefDegInfo(info);
    _pSpnBaseOffsetAngle = angleSpinner(lineUp, "_editorLineUpBaseOffsetAngle", 0, 3, 4);
    label(lineUp, "_labelLineUpOffset", 1, 1, 0);
    GetSysDimOffsetBetMMInfo(info);
    _pSpnOffsetLength = lengthSpinner(lineUp, "_editorLineUpOffsetLength", 1, 1, 4);
    GetSysDimOffsetBetDegInfo(info);
    _pSpnOffsetAngle = angleSpinner(lineUp, "_editorLineUpOffsetAngle", 1, 3, 4);
  }
  GetSysDimAlignStackValueInfo(info);
  _pChkLineUpStackVal = check(lineUp, "checkLineUpStackVal", 2, 0, 3);
  GetSysDimAlignCumulValueInfo(info);
  _pChkLineUpCumulVal = check(lineUp, "checkLineUpCumulVal", 3, 0, 3);
  // The funnel only when the host answers exactly 0; a positive success code is not enough.
  if (GetSysDimCumulAddFunnelInfo(info) == 0) {
    ZEPDlgFrame* funnel = frame(lineUp, "tmpFrame", 4, 0, 4);
    label(funnel, "invLock4", 0, 0, 0);
    _pChkLineUpAutoFunnel = check(funnel, "checkLineUpAutoFunnel", 0, 1);
  }

  // Oriented dimensions: the origin symbol.
  if (WithFrmDimOrigin()) {
    ZEPDlgFrame* oriented = section("frmDimOriented", "I_TPSDimOriented");
    GetSysDimOriginSymbInfo(info);
    _pChkDimOriginSymb = check(oriented, "chkDimOriginSymb", 0, 0);
  }
}

// ---- Showing the values ---------------------------------------------------------------------
// AssocDimOnApproximate is read late, after the line-up values.
void ZEP2DBaseOptDimFrm::Initialize() {
  GetSysDimFollowMouse(_bDimFollowMouse);
  GetSysDimConstantOffset(_bDimConstantOffset);
  GetSysDimConstantOffsetValue(_dDimConstantOffsetValue);
  GetSysDimAssoc3DMod(_iDimAssoc3DMod);
  GetSysDimCreateDrive(_bDimCreateDrive);
  GetSysDimDetectChamfer(_bDimDetectChamfer);
  GetSysDimCreateCircle(_iDimCreateCircle);
  GetSysDimActivateSnapBetSymbols(_bDimActivateSnapBetSymbols);
  GetSysDimMoveSubPart(_bDimMoveSubPart);
  GetSysDimOffsetRefMM(_dDimOffsetRefMM);
  GetSysDimOffsetRefDeg(_dDimOffsetRefDeg);
  GetSysDimOffsetBetMM(_dDimOffsetBetMM);
  GetSysDimOffsetBetDeg(_dDimOffsetBetDeg);
  GetSysDimAlignStackValue(_bDimAlignStackValue);
  GetSysDimAlignCumulValue(_bDimAlignCumulValue);
  GetSysDimCumulAddFunnel(_bDimCumulAddFunnel);
  GetSysAssocDimOnApproximate(_bAssocDimOnApproximate);
  GetSysDimOriginSymb(_bDimOriginSymb);
  UpdateWidgets();
}

void ZEP2DBaseOptDimFrm::Enable(ZEPDrwLockDialog* iControl, bool iEnabled) {
  if (iControl) iControl->SetSensitivity(iEnabled ? ZEPDlgEnable : ZEPDlgDisable);
}

// The 3D associativity values are shown by their dialog when it is built.
void ZEP2DBaseOptDimFrm::UpdateWidgets() {
  // A dimension that follows the cursor has no fixed line position.
  Services::UpdateCheckButton(_pChkDimSketch, _bDimFollowMouse);
  Enable(_pSpnDimLinePosValue, !_bDimFollowMouse);
  Services::UpdateCheckButton(_pChkDimLinePosRelative, _bDimConstantOffset);
  Services::UpdateSpinner(_pSpnDimLinePosValue, _dDimConstantOffsetValue * kToMetres);

  Services::UpdateCheckButton(_pChkDimDriveAuto, _bDimCreateDrive);
  Services::UpdateCheckButton(_pChkDetectChamfer, _bDimDetectChamfer);

  // From the centre unless the setting says from the edge.
  if (_pRadCircleCenter && _pRadCircleEdge) {
    _pRadCircleCenter->SetState(ZEPDlgChecked, 0);
    if (_iDimCreateCircle == kCircleFromEdge) _pRadCircleEdge->SetState(ZEPDlgChecked, 0);
  }

  Services::UpdateCheckButton(_pChkActivateSnapBetSymbols, _bDimActivateSnapBetSymbols);
  Services::UpdateCheckButton(_pChkMoveSubPart, _bDimMoveSubPart);

  Services::UpdateSpinner(_pSpnBaseOffsetLength, _dDimOffsetRefMM * kToMetres);
  Services::UpdateSpinner(_pSpnBaseOffsetAngle, _dDimOffsetRefDeg * kToRadians);
  Services::UpdateSpinner(_pSpnOffsetLength, _dDimOffsetBetMM * kToMetres);
  Services::UpdateSpinner(_pSpnOffsetAngle, _dDimOffsetBetDeg * kToRadians);

  // The funnel is added to cumulated values only.
  Services::UpdateCheckButton(_pChkLineUpStackVal, _bDimAlignStackValue);
  Services::UpdateCheckButton(_pChkLineUpCumulVal, _bDimAlignCumulValue);
  Enable(_pChkLineUpAutoFunnel, _bDimAlignCumulValue != 0);
  Services::UpdateCheckButton(_pChkLineUpAutoFunnel, _bDimCumulAddFunnel);

  Services::UpdateCheckButton(_pChkDimOriginSymb, _bDimOriginSymb);
}

// ---- Writing the user's changes -------------------------------------------------------------
// The controls are tried in a fixed order; the first one that sent the notification is written.
void ZEP2DBaseOptDimFrm::Write(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (Services::GetValueFromCheckButton(_pChkDimSketch, iSender, _bDimFollowMouse) >= 0) {
    SetSysDimFollowMouse(_bDimFollowMouse);
    Enable(_pSpnDimLinePosValue, !_bDimFollowMouse);
  } else if (Services::GetValueFromCheckButton(_pChkDimLinePosRelative, iSender,
                                               _bDimConstantOffset) >= 0) {
    SetSysDimConstantOffset(_bDimConstantOffset);
  } else if (Services::GetValueFromSpinner(_pSpnDimLinePosValue, iSender, kToMillimetres,
                                           _dDimConstantOffsetValue) >= 0) {
    SetSysDimConstantOffsetValue(_dDimConstantOffsetValue);
  } else if (Services::GetValueFromCheckButton(_pChkDimDriveAuto, iSender, _bDimCreateDrive) >= 0) {
    SetSysDimCreateDrive(_bDimCreateDrive);
  } else if (Services::GetValueFromCheckButton(_pChkDetectChamfer, iSender, _bDimDetectChamfer) >=
             0) {
    SetSysDimDetectChamfer(_bDimDetectChamfer);
  } else if (_pRadCircleCenter && _pRadCircleEdge &&
             (iSender == _pRadCircleCenter || iSender == _pRadCircleEdge)) {
    // A radio switch notifies both radios: the value is written once, when it changes.
    const int circle = IsChecked(_pRadCircleEdge) ? kCircleFromEdge : 0;
    if (circle == _iDimCreateCircle) return;
    _iDimCreateCircle = circle;
    SetSysDimCreateCircle(_iDimCreateCircle);
  } else if (Services::GetValueFromCheckButton(_pChkActivateSnapBetSymbols, iSender,
                                               _bDimActivateSnapBetSymbols) >= 0) {
    SetSysDimActivateSnapBetSymbols(_bDimActivateSnapBetSymbols);
  } else if (Services::GetValueFromCheckButton(_pChkMoveSubPart, iSender, _bDimMoveSubPart) >= 0) {
    SetSysDimMoveSubPart(_bDimMoveSubPart);
  } else if (Services::GetValueFromSpinner(_pSpnBaseOffsetLength, iSender, kToMillimetres,
                                           _dDimOffsetRefMM) >= 0) {
    SetSysDimOffsetRefMM(_dDimOffsetRefMM);
  } else if (Services::GetValueFromSpinner(_pSpnBaseOffsetAngle, iSender, kToDegrees,
                                           _dDimOffsetRefDeg) >= 0) {
    SetSysDimOffsetRefDeg(_dDimOffsetRefDeg);
  } else if (Services::GetValueFromSpinner(_pSpnOffsetLength, iSender, kToMillimetres,
                                           _dDimOffsetBetMM) >= 0) {
    SetSysDimOffsetBetMM(_dDimOffsetBetMM);
  } else if (Services::GetValueFromSpinner(_pSpnOffsetAngle, iSender, kToDegrees,
                                           _dDimOffsetBetDeg) >= 0) {
    SetSysDimOffsetBetDeg(_dDimOffsetBetDeg);
  } else if (Services::GetValueFromCheckButton(_pChkLineUpStackVal, iSender,
                                               _bDimAlignStackValue) >= 0) {
    SetSysDimAlignStackValue(_bDimAlignStackValue);
  } else if (Services::GetValueFromCheckButton(_pChkLineUpCumulVal, iSender,
                                               _bDimAlignCumulValue) >= 0) {
    SetSysDimAlignCumulValue(_bDimAlignCumulValue);
    Enable(_pChkLineUpAutoFunnel, _bDimAlignCumulValue != 0);
  } else if (Services::GetValueFromCheckButton(_pChkLineUpAutoFunnel, iSender,
                                               _bDimCumulAddFunnel) >= 0) {
    SetSysDimCumulAddFunnel(_bDimCumulAddFunnel);
  } else if (_pRadForce2DAlways && _pRadForce2DWhenPb && _pRadForce2DNever &&
             (iSender == _pRadForce2DAlways || iSender == _pRadForce2DWhenPb ||
              iSender == _pRadForce2DNever)) {
    const int mode = IsChecked(_pRadForce2DAlways)   ? kForce2DAlways
                     : IsChecked(_pRadForce2DWhenPb) ? kForce2DWhenProblem
                                                     : kForce2DNever;
    if (mode == _iDimAssoc3DMod) return;
    _iDimAssoc3DMod = mode;
    SetSysDimAssoc3DMod(_iDimAssoc3DMod);
  } else if (Services::GetValueFromCheckButton(_pChkAssocDimOnApproximate, iSender,
                                               _bAssocDimOnApproximate) >= 0) {
    SetSysAssocDimOnApproximate(_bAssocDimOnApproximate);
  } else if (Services::GetValueFromCheckButton(_pChkDimOriginSymb, iSender, _bDimOriginSymb) >= 0) {
    SetSysDimOriginSymb(_bDimOriginSymb);
  }
}

// ---- The 3D associativity dialog ------------------------------------------------------------
// A press while the dialog is open shows it again and creates nothing.
void ZEP2DBaseOptDimFrm::NotifPush(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (_pPushAssoc3D && iSender == _pPushAssoc3D)
    _dlgAssoc3D.Open(this, &ZEP2DBaseOptDimFrm::BuildDlgAssoc3D, &ZEP2DBaseOptDimFrm::CloseDlg);
}

void ZEP2DBaseOptDimFrm::BuildDlgAssoc3D(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo) {
  auto* force2DSection = new ZEPDlgToolsOptionsFrame(iDialog, "frameDimAssoc3D", "I_D3M_Dim", 4);
  force2DSection->SetGridConstraints(0, 0, 1, 1, kCell);
  if (ZEPDlgFrame* options = force2DSection->GetOptionsFrame()) {
    ioInfo.Reset();
    GetSysDimAssoc3DModInfo(ioInfo);
    auto* force2DLock = new ZEPDrwLockFrame(options, "_frameDimForce2D", ioInfo, 0x80001);
    force2DLock->SetGridConstraints(0, 0, 1, 1, kCell);
    if (ZEPDialog* radios = force2DLock->GetDialog()) {
      const char* const names[] = {"_radioDimForce2DAlways", "_radioDimForce2DWhenPb",
                                   "_radioDimForce2DNever"};
      ZEPDlgRadioButton** pointers[] = {&_pRadForce2DAlways, &_pRadForce2DWhenPb,
                                        &_pRadForce2DNever};
      for (short row = 0; row < 3; ++row) {
        auto* r = new ZEPDlgRadioButton(radios, names[row], 0);
        r->SetGridConstraints(row, 0, 1, 1, kCell);
        AddAnalyseNotificationCB(r, r->GetRadBModifyNotification(), &ZEP2DBaseOptDimFrm::Write,
                                 nullptr);
        *pointers[row] = r;
      }
    }
  }

  auto* approxSection = new ZEPDlgToolsOptionsFrame(iDialog, "frameAssocDimApprox", "", 2);
  approxSection->SetGridConstraints(1, 0, 1, 1, kCell);
  if (ZEPDlgFrame* options = approxSection->GetOptionsFrame()) {
    ioInfo.Reset(); // a record of its own, whatever the first hook left
    GetSysAssocDimOnApproximateInfo(ioInfo);
    _pChkAssocDimOnApproximate =
        new ZEPDrwLockCheckButton(options, "chkAssocDimOnApproximate", ioInfo, 0);
    _pChkAssocDimOnApproximate->SetGridConstraints(0, 1, 1, 1, kCell);
    AddAnalyseNotificationCB(_pChkAssocDimOnApproximate->GetDialog(),
                             _pChkAssocDimOnApproximate->GetChkBModifyNotification(),
                             &ZEP2DBaseOptDimFrm::Write, nullptr);
  }

  if (_pRadForce2DAlways && _pRadForce2DWhenPb && _pRadForce2DNever) {
    ZEPDlgRadioButton* chosen = _iDimAssoc3DMod == kForce2DAlways        ? _pRadForce2DAlways
                                : _iDimAssoc3DMod == kForce2DWhenProblem ? _pRadForce2DWhenPb
                                                                         : _pRadForce2DNever;
    chosen->SetState(ZEPDlgChecked, 0);
  }
  Services::UpdateCheckButton(_pChkAssocDimOnApproximate, _bAssocDimOnApproximate);
}

void ZEP2DBaseOptDimFrm::CloseDlg(ZEPCommand* iSender, ZEPNotification*, void*) {
  _dlgAssoc3D.Close(iSender);
}
