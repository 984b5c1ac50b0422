#include "ZEP2DBaseOptManipFrm.h"

#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockLabel.h"
#include "ZEPDrwLockSpinner.h"
#include "ZEPDrwSettingsServices.h"

#include <climits>
#include <cmath>

#define ZEP_SETTING(Name, Kind) ZEP_DEFINE_SETTING_HOOKS(ZEP2DBaseOptManipFrm, Name, Kind)
#include "ZEP2DBaseOptManipFrm.def"
#undef ZEP_SETTING

namespace {
using Services = ZEPDrwSettingsServices;
using Page = ZEP2DBaseOptManipFrm;

// A matrix row: its name once, its two slots derived from it (dimension attributes add "Dim").
#define ZEP_DIM_ROW(Row, Icon) {#Row, Icon, Page::kSlotDim##Row##Cre, Page::kSlotDim##Row##Mod}
#define ZEP_ANNOT_ROW(Row, Icon) {#Row, Icon, Page::kSlot##Row##Cre, Page::kSlot##Row##Mod}
// Screen order; "ChangeSymbol" is third on screen but last among the dimension hooks.
const Page::MatrixRow kMatrixRows[] = {
    ZEP_DIM_ROW(ORun, "S_DrwManipTranslation"),
    ZEP_DIM_ROW(Blank, "S_DrwManipTranslation"),
    ZEP_DIM_ROW(ChangeSymbol, "S_DrwManipMoveLeader"),
    ZEP_DIM_ROW(Before, "S_DrwManipInsertText"),
    ZEP_DIM_ROW(After, "S_DrwManipInsertText"),
    ZEP_DIM_ROW(MoveValue, "S_DrwManipMoveValue"),
    ZEP_DIM_ROW(MoveDimLine, "S_DrwManipTranslation"),
    ZEP_DIM_ROW(Move2dPart, "S_DrwManipTranslation"),
    ZEP_DIM_ROW(MoveLeader, "S_DrwManipMoveLeader"),
    ZEP_ANNOT_ROW(ManipRotateAnnot, "S_DrwManipRotate"),
    ZEP_ANNOT_ROW(ManipTranslationAnnot, "S_DrwManipTranslation"),
    ZEP_ANNOT_ROW(ManipResizeAnnot, "S_DrwManipResize"),
    ZEP_ANNOT_ROW(ManipMoveValueAnnot, "S_DrwManipMoveValue"),
    ZEP_ANNOT_ROW(ManipTranslationLeader, "S_DrwManipTranslation"),
    ZEP_ANNOT_ROW(ManipMoveLeaderAnchor, "S_DrwManipMoveLeaderAnchor"),
    ZEP_ANNOT_ROW(ManipMoveLeader, "S_DrwManipMoveLeader"),
    ZEP_ANNOT_ROW(ManipMovableDatum, "S_DrwManipMovableDatum"),
};
#undef ZEP_DIM_ROW
#undef ZEP_ANNOT_ROW
constexpr int kRowCount = sizeof kMatrixRows / sizeof kMatrixRows[0];
static_assert(2 * kRowCount == Page::kSlotCount - Page::kSlotDimORunCre,
              "every matrix attribute has its row");
// The annotation row built only with dimensions.
constexpr int kDatumRow = kRowCount - 1;

constexpr double kToRadians = 0.017453292519943393;
constexpr double kToDegrees = 57.295779513082;

// The transparency percent of a spinner fraction, rounded to the nearest point so that the
// value shown is the value kept (0.29 * 100 is 28.999...).
int PercentOf(double iFraction) {
  const double percent = std::round(iFraction * 100.0);
  if (std::isnan(percent)) return 0;
  if (percent <= static_cast<double>(INT_MIN)) return INT_MIN;
  if (percent >= static_cast<double>(INT_MAX)) return INT_MAX;
  return static_cast<int>(percent);
}

ZEPDlgFrame* Section(ZEPDialog* iPage, const char* iName, const char* iIcon, unsigned long iStyle,
                     short& ioRow) {
  auto* section = new ZEPDlgToolsOptionsFrame(iPage, iName, iIcon, iStyle);
  section->SetGridConstraints(ioRow++, 0, 1, 1, 0x1E);
  return section->GetOptionsFrame();
}

ZEPDrwLockLabel* Label(ZEPDialog* iFrame, const ZEPString& iName, int iWithText, short iRow,
                       short iColumn, unsigned int iFlags = 0x1E) {
  auto* label = new ZEPDrwLockLabel(iFrame, iName, iWithText);
  label->SetGridConstraints(iRow, iColumn, 1, 1, iFlags);
  return label;
}
} // namespace

const ZEPSettingSlotHooks<ZEP2DBaseOptManipFrm>& ZEP2DBaseOptManipFrm::Hooks(int iSlot) {
  static const ZEPSettingSlotHooks<ZEP2DBaseOptManipFrm> hooks[] = {
#define ZEP_SETTING(Name, Kind) ZEP_SETTING_SLOT_HOOKS(ZEP2DBaseOptManipFrm, Name, Kind)
#include "ZEP2DBaseOptManipFrm.def"
#undef ZEP_SETTING
  };
  static_assert(sizeof hooks / sizeof hooks[0] == kSlotCount, "one row of hooks per attribute");
  return hooks[iSlot];
}

const ZEP2DBaseOptManipFrm::MatrixRow* ZEP2DBaseOptManipFrm::MatrixRows(int& oCount) {
  oCount = kRowCount;
  return kMatrixRows;
}

ZEP2DBaseOptManipFrm::ZEP2DBaseOptManipFrm(ZEPDialog* iParent, const ZEPString& iName)
    : ZEPDlgFrame(iParent, iName, 0x80001) {}

ZEP2DBaseOptManipFrm::~ZEP2DBaseOptManipFrm() {
  _pSpnRefSize = _pSpnTransparency = _pSpnGridSpacing = _pSpnRotSnapAngle = nullptr;
  for (ZEPDrwLockCheckButton*& check : _pChk)
    check = nullptr;
}

ZEPString ZEP2DBaseOptManipFrm::GetResourceFilename(int iIndex) const {
  if (iIndex >= 1) return ZEPDlgFrame::GetResourceFilename(iIndex - 1);
  return "ZEP2DBaseOptManipFrm";
}

unsigned char ZEP2DBaseOptManipFrm::WithDimManipSection() { return 1; }

// ---- widget tree ------------------------------------------------------------------------------
ZEPDrwLockCheckButton* ZEP2DBaseOptManipFrm::Check(ZEPDialog* iFrame, int iSlot,
                                                   const ZEPString& iName, short iRow,
                                                   short iColumn, short iWidth,
                                                   unsigned int iFlags, ZEPSettingInfo& ioInfo) {
  (this->*Hooks(iSlot).info)(ioInfo);
  auto* check = new ZEPDrwLockCheckButton(iFrame, iName, ioInfo, 0);
  check->SetGridConstraints(iRow, iColumn, iWidth, 1, iFlags);
  AddAnalyseNotificationCB(check->GetDialog(), check->GetChkBModifyNotification(),
                           &ZEP2DBaseOptManipFrm::Write, nullptr);
  return _pChk[iSlot] = check;
}

// A spinner in column 1 of its section, beside its caption; the caller has filled iInfo.
ZEPDrwLockSpinner* ZEP2DBaseOptManipFrm::Spinner(ZEPDialog* iFrame, const char* iName, short iRow,
                                                 const ZEPSettingInfo& iInfo) {
  auto* spinner = new ZEPDrwLockSpinner(iFrame, iName, iInfo, 0x60000);
  spinner->SetGridConstraints(iRow, 1, 1, 1, 0x1E);
  spinner->SetVisibleTextWidth(5);
  AddAnalyseNotificationCB(spinner->GetDialog(), spinner->GetSpinnerModifyNotification(),
                           &ZEP2DBaseOptManipFrm::Write, nullptr);
  return spinner;
}

void ZEP2DBaseOptManipFrm::Build(unsigned char iWithDimensions) {
  ZEPSettingInfo info;
  short row = 0;

  ZEPDlgFrame* manip = Section(this, "frameManip", "I_D3M_Select", 0, row);
  Label(manip, "labelManipTransparency", 1, 0, 0);
  GetSysManipTransparencyInfo(info);
  _pSpnTransparency = Spinner(manip, "editorManipTransparency", 0, info);
  if (ZEPDlgSpinner* inner = _pSpnTransparency->GetSpinner()) {
    // A fraction from 0 to 1, shown as a percentage.
    inner->SetVisibleTextWidth(6);
    inner->SetMinMaxStep(0.0, 1.0, 0.1, 1);
    inner->SetUnit(25);
  }
  Label(manip, "labelManipRefSize", 1, 1, 0);
  GetSysManipRefSizeInfo(info);
  _pSpnRefSize = Spinner(manip, "editorManipRefSize", 1, info);
  Services::SetLengthUnitToDlgControl(_pSpnRefSize->GetSpinner(), ZEPCkeScaleNormal, 1, 3, 0);
  Services::SetLengthMinMaxStep(_pSpnRefSize->GetSpinner(), ZEPCkeScaleNormal, 1, 0.0, 10000.0,
                                1.0);
  Check(manip, kSlotManipZoom, "checkManipZoom", 2, 0, 1, 0x1E, info);

  ZEPDlgFrame* grid = Section(this, "framePaperGrid", "I_DisplayGrid", 4, row);
  ZEPDrwLockLabel* spacing = Label(grid, "labelSpacing", 1, 0, 0);
  GetSysPaperGridSpacingInfo(info);
  _pSpnGridSpacing = Spinner(grid, "spnPaperGridSpacing", 0, info);
  _pSpnGridSpacing->SetLongHelp(spacing->GetLongHelp());
  Services::SetLengthUnitToDlgControl(_pSpnGridSpacing->GetSpinner(), ZEPCkeScaleNormal, 1, 3, 0);
  Services::SetLengthMinMaxStep(_pSpnGridSpacing->GetSpinner(), ZEPCkeScaleNormal, 1, 0.0,
                                10000.0, 1.0);
  Check(grid, kSlotSnapToPaperGrid, "chkSnapToPaperGrid", 1, 0, 2, 0x1E, info);

  ZEPDlgFrame* rotation = Section(this, "frameRotation", "I_D3M_Rotate", 4, row);
  ZEPDrwLockLabel* angle = Label(rotation, "labelRotSnapAngle", 1, 0, 0);
  GetSysRotationSnapAngleInfo(info);
  _pSpnRotSnapAngle = Spinner(rotation, "spinnerRotSnapAngle", 0, info);
  _pSpnRotSnapAngle->SetValue(1.0, 0);
  _pSpnRotSnapAngle->SetLongHelp(angle->GetLongHelp());
  if (auto* inner = ZEPSysDynamicCast<ZEPDlgSpinner>(_pSpnRotSnapAngle->GetDialog())) {
    Services::SetAngleUnitToDlgControl(inner, 3, 0);
    Services::SetAngleMinMaxStep(inner, -180.0, 180.0, 1.0);
  }
  Check(rotation, kSlotRotationAutoSnap, "checkRotSnapAuto", 1, 0, 2, 0x1E, info);

  ZEPDlgFrame* orientation =
      Section(this, "frameOrientation", "I_D3M_LeaderOrientation", 4, row);
  Check(orientation, kSlotSnapOnDirection, "checkSnapOnDirection", 0, 0, 1, 0x1E, info);

  if (iWithDimensions && WithDimManipSection())
    BuildMatrix(Section(this, "frameDim", "I_D3M_Dim", 4, row), true, true, info);
  BuildMatrix(Section(this, "frameAnnotManip", "I_D3M_Text", 4, row), false, iWithDimensions != 0,
              info);
}

// Five columns: icon, row text, first checks, a padlock-wide spacer, second checks.
void ZEP2DBaseOptManipFrm::BuildMatrix(ZEPDialog* iFrame, bool iDimensions, bool iWithDatum,
                                       ZEPSettingInfo& ioInfo) {
  const char* header1 = iDimensions ? "_labelDimCreation" : "_labelAnnotSelection";
  const char* header2 = iDimensions ? "_labelDimModification" : "_labelAnnotEdition";
  (new ZEPDlgLabel(iFrame, header1, 0))->SetGridConstraints(0, 2, 1, 1, 0x7E);
  Label(iFrame, iDimensions ? "lblSpaceDim" : "lblSpaceAnnot", 0, 0, 3, 0x7E);
  (new ZEPDlgLabel(iFrame, header2, 0))->SetGridConstraints(0, 4, 1, 1, 0x7E);

  const ZEPString labelPrefix = iDimensions ? "_labelDim" : "_label";
  const ZEPString checkPrefix = iDimensions ? "_checkDim" : "_check";
  const int first = iDimensions ? 0 : kDimensionRows;
  const int last = iDimensions ? kDimensionRows : (iWithDatum ? kRowCount : kDatumRow);
  short gridRow = 1;
  for (int i = first; i < last; ++i, ++gridRow) {
    const MatrixRow& r = kMatrixRows[i];
    Label(iFrame, ZEPString("_labelIcon") + r.name, 1, gridRow, 0, 0x7E)->SetIconName(r.icon);
    auto* text = new ZEPDlgLabel(iFrame, labelPrefix + r.name, 0);
    text->SetGridConstraints(gridRow, 1, 1, 1, 0x7A);
    // The row's text and help live only under the row label's name.
    for (ZEPDrwLockCheckButton* check :
         {Check(iFrame, r.creSlot, checkPrefix + r.name + "Cre", gridRow, 2, 1, 0x7E, ioInfo),
          Check(iFrame, r.modSlot, checkPrefix + r.name + "Mod", gridRow, 4, 1, 0x7E, ioInfo)}) {
      check->SetTitle(ZEPUnicodeString());
      check->SetLongHelp(text->GetLongHelp());
    }
  }
}

// ---- values -------------------------------------------------------------------------------------
void ZEP2DBaseOptManipFrm::Initialize() {
  GetSysManipRefSize(_dRefSize);
  GetSysManipTransparency(_iTransparency);
  GetSysManipZoom(_bFlag[kSlotManipZoom]);
  GetSysPaperGridSpacing(_dGridSpacing);
  GetSysSnapToPaperGrid(_bFlag[kSlotSnapToPaperGrid]);
  GetSysRotationSnapAngle(_dRotSnapAngle);
  GetSysRotationAutoSnap(_bFlag[kSlotRotationAutoSnap]);
  GetSysSnapOnDirection(_bFlag[kSlotSnapOnDirection]);
  // Every matrix value, built or not.
  for (int slot = kSlotDimORunCre; slot < kSlotCount; ++slot)
    (this->*Hooks(slot).get)(_bFlag[slot]);
  UpdateWidgets();
}

void ZEP2DBaseOptManipFrm::UpdateWidgets() {
  Services::UpdateSpinner(_pSpnRefSize, _dRefSize * 0.001);
  Services::UpdateSpinner(_pSpnGridSpacing, _dGridSpacing * 0.001);
  Services::UpdateSpinner(_pSpnTransparency, static_cast<double>(_iTransparency) / 100.0);
  Services::UpdateCheckButton(_pChk[kSlotManipZoom], _bFlag[kSlotManipZoom]);
  Services::UpdateCheckButton(_pChk[kSlotSnapToPaperGrid], _bFlag[kSlotSnapToPaperGrid]);
  Services::UpdateSpinner(_pSpnRotSnapAngle, _dRotSnapAngle * kToRadians);
  Services::UpdateCheckButton(_pChk[kSlotRotationAutoSnap], _bFlag[kSlotRotationAutoSnap]);
  Services::UpdateCheckButton(_pChk[kSlotSnapOnDirection], _bFlag[kSlotSnapOnDirection]);
  for (int slot = kSlotDimORunCre; slot < kSlotCount; ++slot)
    Services::UpdateCheckButton(_pChk[slot], _bFlag[slot]);
}

void ZEP2DBaseOptManipFrm::Write(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (Services::GetValueFromSpinner(_pSpnRefSize, iSender, 1000.0, _dRefSize) >= 0) {
    SetSysManipRefSize(_dRefSize);
    return;
  }
  if (Services::GetValueFromSpinner(_pSpnGridSpacing, iSender, 1000.0, _dGridSpacing) >= 0) {
    SetSysPaperGridSpacing(_dGridSpacing);
    return;
  }
  double fraction = 0.0;
  if (Services::GetValueFromSpinner(_pSpnTransparency, iSender, 1.0, fraction) >= 0) {
    _iTransparency = PercentOf(fraction);
    SetSysManipTransparency(_iTransparency);
    return;
  }
  if (Services::GetValueFromSpinner(_pSpnRotSnapAngle, iSender, kToDegrees, _dRotSnapAngle) >= 0) {
    SetSysRotationSnapAngle(_dRotSnapAngle);
    return;
  }
  // Check buttons: each writes its own attribute, whatever its place on screen.
  for (int slot = 0; slot < kSlotCount; ++slot) {
    if (!Hooks(slot).set ||
        Services::GetValueFromCheckButton(_pChk[slot], iSender, _bFlag[slot]) < 0)
      continue;
    (this->*Hooks(slot).set)(_bFlag[slot]);
    return;
  }
}
