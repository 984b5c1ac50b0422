#include "ZEP2DBaseOptDisplayFrm.h"

#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockComboColor.h"
#include "ZEPDrwLockComboWeight.h"
#include "ZEPDrwLockFrame.h"
#include "ZEPDrwLockLabel.h"
#include "ZEPDrwSettingsServices.h"

#include <string>

#define ZEP_SETTING(Name, Kind) ZEP_DEFINE_SETTING_HOOKS(ZEP2DBaseOptDisplayFrm, Name, Kind)
#include "ZEP2DBaseOptDisplayFrm.def"
#undef ZEP_SETTING

namespace {
using Services = ZEPDrwSettingsServices;

ZEPDlgFrame* Section(ZEPDialog* iParent, const char* iName, const char* iIcon, int iRow) {
  auto* section = new ZEPDlgToolsOptionsFrame(iParent, iName, iIcon, *iIcon ? 4 : 6);
  section->SetGridConstraints(static_cast<short>(iRow), 0, 1, 1, 0x1E);
  return section->GetOptionsFrame();
}

void Label(ZEPDialog* iFrame, const char* iName, int iWithText, short iRow, short iColumn,
           short iWidth = 1) {
  (new ZEPDrwLockLabel(iFrame, iName, iWithText))
      ->SetGridConstraints(iRow, iColumn, iWidth, 1, 0x1E);
}

unsigned long Sensitivity(bool iEnabled) { return iEnabled ? ZEPDlgEnable : ZEPDlgDisable; }

template <class Control> void Enable(Control* iControl, bool iEnabled) {
  if (iControl) iControl->SetSensitivity(Sensitivity(iEnabled));
}
} // namespace

// The frames of the analysis display dialog that hold state rows, in dialog order.
enum StateFrame : short { kFrameDim, kFrameGeometries, kFrameCallouts, kFrameWelding };

// A row of the analysis display dialog: its frame, the state's name (the widgets are "chk" and
// "cmb" followed by it) and the slots of the state and of its colour.
struct ZEP2DBaseOptDisplayFrm::StateRow {
  StateFrame frame;
  const char* name;
  int state, color;
};
#define ZEP_STATE_ROW(Frame, Name)                                                                 \
  { Frame, #Name, kSlot##Name, kSlot##Name##Color }
// Dialog order, which is not the order of the hooks.
const ZEP2DBaseOptDisplayFrm::StateRow ZEP2DBaseOptDisplayFrm::kStateRows[] = {
    ZEP_STATE_ROW(kFrameDim, AnnotDelGeom),
    ZEP_STATE_ROW(kFrameDim, AnnotUnloadGeom),
    ZEP_STATE_ROW(kFrameDim, AnnotInvalid),
    ZEP_STATE_ROW(kFrameDim, DimNotUpToDate),
    ZEP_STATE_ROW(kFrameDim, DimNonAssoc),
    ZEP_STATE_ROW(kFrameDim, DimIsolated),
    ZEP_STATE_ROW(kFrameDim, DimBroken),
    ZEP_STATE_ROW(kFrameDim, DimFake),
    ZEP_STATE_ROW(kFrameDim, DimDriving),
    ZEP_STATE_ROW(kFrameDim, Dim3DCst),
    ZEP_STATE_ROW(kFrameDim, TechFeatDim),
    ZEP_STATE_ROW(kFrameDim, DimTrue),
    ZEP_STATE_ROW(kFrameDim, DimOnNonVisGeom),
    ZEP_STATE_ROW(kFrameDim, DimClipped),
    ZEP_STATE_ROW(kFrameGeometries, FilterGeneratedElements),
    ZEP_STATE_ROW(kFrameCallouts, CalloutLastUpdateFailed),
    ZEP_STATE_ROW(kFrameCallouts, IsolatedCallout),
    ZEP_STATE_ROW(kFrameCallouts, NotPerpendicularCallout),
    ZEP_STATE_ROW(kFrameWelding, DrwWeldNotUpToDate),
};
#undef ZEP_STATE_ROW

// A row of the diagnosis colours dialog: "label" and "cmb" followed by the name.
struct ZEP2DBaseOptDisplayFrm::DiagRow {
  const char* name;
  int slot;
};
const ZEP2DBaseOptDisplayFrm::DiagRow ZEP2DBaseOptDisplayFrm::kDiagRows[] = {
    {"OverConsElts", kSlotOverConsElts},
    {"InconsElts", kSlotInconsElts},
    {"NotChanElts", kSlotNotChanElts},
    {"IsoConsElts", kSlotIsoConsElts},
};

// The hooks of the kinds the flag table does not cover, by slot: ints and colours.
struct ZEP2DBaseOptDisplayFrm::ColorHooks {
  long (ZEP2DBaseOptDisplayFrm::*getInt)(int&);
  long (ZEP2DBaseOptDisplayFrm::*setInt)(const int&);
  long (ZEP2DBaseOptDisplayFrm::*getColor)(int&, int&, int&);
  long (ZEP2DBaseOptDisplayFrm::*setColor)(const int&, const int&, const int&);
  long (ZEP2DBaseOptDisplayFrm::*getUColor)(unsigned int&, unsigned int&, unsigned int&);
  long (ZEP2DBaseOptDisplayFrm::*setUColor)(const unsigned int&, const unsigned int&,
                                            const unsigned int&);
};

const ZEPSettingSlotHooks<ZEP2DBaseOptDisplayFrm>& ZEP2DBaseOptDisplayFrm::Hooks(int iSlot) {
  static const ZEPSettingSlotHooks<ZEP2DBaseOptDisplayFrm> hooks[] = {
#define ZEP_SETTING(Name, Kind) ZEP_SETTING_SLOT_HOOKS(ZEP2DBaseOptDisplayFrm, Name, Kind)
#include "ZEP2DBaseOptDisplayFrm.def"
#undef ZEP_SETTING
  };
  static_assert(sizeof hooks / sizeof hooks[0] == kSlotCount, "one row of hooks per attribute");
  return hooks[iSlot];
}

const ZEP2DBaseOptDisplayFrm::ColorHooks& ZEP2DBaseOptDisplayFrm::ColorHooksOf(int iSlot) {
  using P = ZEP2DBaseOptDisplayFrm;
#define ZEP_VALUE_HOOKS_Flag(Name) {nullptr, nullptr, nullptr, nullptr, nullptr, nullptr},
#define ZEP_VALUE_HOOKS_Int(Name)                                                                  \
  {&P::GetSys##Name, &P::SetSys##Name, nullptr, nullptr, nullptr, nullptr},
#define ZEP_VALUE_HOOKS_ColorInt(Name)                                                             \
  {nullptr, nullptr, &P::GetSys##Name, &P::SetSys##Name, nullptr, nullptr},
#define ZEP_VALUE_HOOKS_ColorUInt(Name)                                                            \
  {nullptr, nullptr, nullptr, nullptr, &P::GetSys##Name, &P::SetSys##Name},
  static const ColorHooks hooks[] = {
#define ZEP_SETTING(Name, Kind) ZEP_VALUE_HOOKS_##Kind(Name)
#include "ZEP2DBaseOptDisplayFrm.def"
#undef ZEP_SETTING
  };
#undef ZEP_VALUE_HOOKS_Flag
#undef ZEP_VALUE_HOOKS_Int
#undef ZEP_VALUE_HOOKS_ColorInt
#undef ZEP_VALUE_HOOKS_ColorUInt
  static_assert(sizeof hooks / sizeof hooks[0] == kSlotCount, "one row of hooks per attribute");
  return hooks[iSlot];
}

ZEP2DBaseOptDisplayFrm::ZEP2DBaseOptDisplayFrm(ZEPDialog* iParent, const ZEPString& iName)
    : ZEPDlgFrame(iParent, iName, 0x80001) {
  static_assert(sizeof kStateRows / sizeof kStateRows[0] == 19, "one row per analysed state");
  for (const StateRow& row : kStateRows)
    _dlgAnalysisDisplay.Track(_pChk[row.state], _pCmbColor[row.color]);
  _dlgAnalysisDisplay.Track(_pChk[kSlotPatternContourPitch], _pCmbPatternContourPitch);
  for (const DiagRow& row : kDiagRows)
    _dlgVisuDiagColor.Track(_pCmbColor[row.slot]);
}

ZEP2DBaseOptDisplayFrm::~ZEP2DBaseOptDisplayFrm() {
  for (int slot = 0; slot < kSlotCount; ++slot) {
    _pChk[slot] = nullptr;
    _pCmbColor[slot] = nullptr;
  }
  _pCmbPatternContourPitch = nullptr;
  _pRadBackgroundInViewFrameAuto = _pRadBackgroundInViewFrameDemand = nullptr;
  _pRadCappingColorFix = _pRadCappingColorFromFace = nullptr;
  _pRadCappingPatternNone = _pRadCappingPatternMaterial = nullptr;
  _pPushDiagElementsColors = _pPushDiagGeometriesColors = nullptr;
}

ZEPString ZEP2DBaseOptDisplayFrm::GetResourceFilename(int iIndex) const {
  if (iIndex >= 1) return ZEPDlgFrame::GetResourceFilename(iIndex - 1);
  return "ZEP2DBaseOptDisplayFrm";
}

// ---- widget tree ------------------------------------------------------------------------------
// iOptional: built only when the info hook answers exactly 0 (a positive success is not enough).
ZEPDrwLockCheckButton* ZEP2DBaseOptDisplayFrm::Check(ZEPDialog* iFrame, int iSlot,
                                                     const char* iName, short iRow, short iColumn,
                                                     short iWidth, unsigned int iJustification,
                                                     ZEPSettingInfo& ioInfo, bool iOptional) {
  if ((this->*Hooks(iSlot).info)(ioInfo) != 0 && iOptional) return nullptr;
  auto* check = new ZEPDrwLockCheckButton(iFrame, iName, ioInfo, 0);
  check->SetGridConstraints(iRow, iColumn, iWidth, 1, iJustification);
  AddAnalyseNotificationCB(check->GetDialog(), check->GetChkBModifyNotification(),
                           &ZEP2DBaseOptDisplayFrm::Write, nullptr);
  return _pChk[iSlot] = check;
}

ZEPDrwLockComboColor* ZEP2DBaseOptDisplayFrm::ColorCombo(ZEPDialog* iFrame, int iSlot,
                                                         const char* iName, short iRow,
                                                         short iColumn, unsigned int iJustification,
                                                         ZEPSettingInfo& ioInfo) {
  (this->*Hooks(iSlot).info)(ioInfo);
  auto* combo = new ZEPDrwLockComboColor(iFrame, iName, ioInfo);
  combo->SetGridConstraints(iRow, iColumn, 1, 1, iJustification);
  if (ZEPComboColor* inner = combo->GetCombo()) {
    combo->SetVisibleTextWidth(8);
    // The colour combo itself is the sender the value transfer recognises.
    AddAnalyseNotificationCB(inner, inner->GetComboSelectNotification(),
                             &ZEP2DBaseOptDisplayFrm::Write, nullptr);
  }
  return _pCmbColor[iSlot] = combo;
}

ZEPDlgRadioButton* ZEP2DBaseOptDisplayFrm::Radio(ZEPDialog* iGroup, const char* iName, short iRow,
                                                 short iWidth) {
  auto* radio = new ZEPDlgRadioButton(iGroup, iName, 0);
  radio->SetGridConstraints(iRow, 0, iWidth, 1, 0x1E);
  AddAnalyseNotificationCB(radio, radio->GetRadBModifyNotification(),
                           &ZEP2DBaseOptDisplayFrm::Write, nullptr);
  return radio;
}

ZEPDlgPushButton* ZEP2DBaseOptDisplayFrm::PushButton(ZEPDialog* iFrame, const char* iName,
                                                     short iRow) {
  auto* push = new ZEPDlgPushButton(iFrame, iName, 0);
  push->SetGridConstraints(iRow, 1, 1, 1, 0x1E);
  AddAnalyseNotificationCB(push, push->GetPushBActivateNotification(),
                           &ZEP2DBaseOptDisplayFrm::NotifPush, nullptr);
  return push;
}

void ZEP2DBaseOptDisplayFrm::Build(int& ioRow, unsigned char iWithTrackHistory) {
  ZEPSettingInfo info;
  BuildTree(ioRow, iWithTrackHistory, info);
  BuildDesignMode(ioRow, info);
  if (WithFrmVisualization()) BuildVisualization(ioRow, info);
  if (WithFrmCapping()) BuildCapping(ioRow, info);
}

void ZEP2DBaseOptDisplayFrm::BuildTree(int& ioRow, unsigned char iWithTrackHistory,
                                       ZEPSettingInfo& ioInfo) {
  ZEPDlgFrame* frame = Section(this, "frameTree", "I_3DNTreeView", ioRow++);
  short row = 0;
  if (iWithTrackHistory &&
      Check(frame, kSlotTrackHistory, "checkTrackHistory", 0, 0, 3, 0x1E, ioInfo, true))
    row = 1;
  Label(frame, "labelDisplay", 1, row++, 0, 3);
  Label(frame, "invLock", 0, row, 0);
  // Rows stay compact: a check that is not built leaves no gap.
  auto checks = [&](std::initializer_list<std::pair<int, const char*>> iChecks) {
    for (const auto& c : iChecks)
      if (Check(frame, c.first, c.second, row, 1, 2, 0x1E, ioInfo, true)) ++row;
  };
  checks({{kSlotParameters, "checkParameters"},
          {kSlotRelations, "checkRelations"},
          {kSlotGenViewSpec, "checkGenViewSpec"},
          {kSlotCallouts, "checkCallouts"},
          {kSlotFixTogether, "checkFixTogether"}});
  Check(frame, kSlotHideIn3DStatus, "checkHideIn3DStatus", static_cast<short>(row - 1), 3, 1, 0x1E,
        ioInfo, true);
  checks({{kSlotDitto, "checkDitto"},
          {kSlotUseEdges, "checkUseEdges"},
          {kSlotUseEdgeInput, "checkUseEdgeInput"},
          {kSlotReports, "checkReports"},
          {kSlotAnnotInSpecTreeGeomFeat, "checkAnnotInSpecTreeGeomFeat"},
          {kSlotAnnotInSpecTreePlane, "checkAnnotInSpecTreePlane"}});
  if (GetSysAnnotInSpecTreeAnnotSetInfo(ioInfo) == 0) {
    Label(frame, "invLock1", 0, row, 1);
    Check(frame, kSlotAnnotInSpecTreeAnnotSet, "checkAnnotInSpecTreeAnnotSet", row, 2, 2, 0x1E,
          ioInfo, false);
  }
}

void ZEP2DBaseOptDisplayFrm::BuildDesignMode(int& ioRow, ZEPSettingInfo& ioInfo) {
  ZEPDlgFrame* frame = Section(this, "frameDesignMode", "I_D3M_ColorAnalysis", ioRow++);
  Check(frame, kSlotDimAnalysisDisplay, "checkDesignMode", 0, 0, 1, 0x1E, ioInfo, false);
  _pPushDiagElementsColors = PushButton(frame, "diagElementsColorsPushButton", 0);
  if (Check(frame, kSlotVisuDiagnostic, "checkVisualizationDiag", 1, 0, 1, 0x1E, ioInfo, true))
    _pPushDiagGeometriesColors = PushButton(frame, "diagGeometriesColorsPushButton", 1);
}

void ZEP2DBaseOptDisplayFrm::BuildVisualization(int& ioRow, ZEPSettingInfo& ioInfo) {
  ZEPDlgFrame* frame = Section(this, "frameVisulization", "I_DbsEmptyIcon", ioRow++);
  Check(frame, kSlotDisplayBackAndCutting, "chkDisplayBackAndCutting", 0, 0, 2, 0x1E, ioInfo,
        false);
  Check(frame, kSlotPropagateHighlight, "chkPropagateHighlight", 1, 0, 2, 0x1E, ioInfo, false);
  Check(frame, kSlotBackgroundInViewFrame, "chkBackgroundInViewFrame", 2, 0, 2, 0x1E, ioInfo,
        false);
  Label(frame, "lblInv", 0, 3, 0);
  GetSysBackgroundInViewFrameModeInfo(ioInfo);
  auto* modes = new ZEPDrwLockFrame(frame, "frmViewFrameMode", ioInfo, 0x80001);
  modes->SetGridConstraints(3, 1, 1, 1, 0x1E);
  if (ZEPDialog* group = modes->GetDialog()) {
    _pRadBackgroundInViewFrameAuto = Radio(group, "radBackgroundInViewFrameAuto", 0, 1);
    _pRadBackgroundInViewFrameDemand = Radio(group, "radBackgroundInViewFrameDemand", 1, 1);
  }
}

void ZEP2DBaseOptDisplayFrm::BuildCapping(int& ioRow, ZEPSettingInfo& ioInfo) {
  ZEPDlgFrame* frame = Section(this, "frmCappingProperties", "I_D3M_Clipping", ioRow++);
  Label(frame, "lblCappingBackground", 1, 0, 0, 2);
  Label(frame, "lblInv", 0, 1, 0);
  GetSysCappingBackgroundInfo(ioInfo);
  auto* background = new ZEPDrwLockFrame(frame, "frmCappingBackground", ioInfo, 0x80001);
  background->SetGridConstraints(1, 1, 1, 1, 0x1E);
  if (ZEPDialog* group = background->GetDialog()) {
    _pRadCappingColorFromFace = Radio(group, "radCappingColorFromFace", 0, 3);
    _pRadCappingColorFix = Radio(group, "radCappingColorFix", 1, 1);
    // Inside the group: locking the background locks the colour and its scale too.
    ColorCombo(group, kSlotCappingColor, "cmbCappingColor", 1, 1, 0x1E, ioInfo);
    Check(group, kSlotCappingColorScale, "chkCappingColorScale", 1, 2, 2, 0x1E, ioInfo, false);
  }
  Label(frame, "lblPattern", 1, 2, 0, 2);
  Label(frame, "lblInvPattern", 0, 3, 0);
  GetSysCappingPatternInfo(ioInfo);
  auto* pattern = new ZEPDrwLockFrame(frame, "frmCappingPattern", ioInfo, 0x80001);
  pattern->SetGridConstraints(3, 1, 1, 1, 0x1E);
  if (ZEPDialog* group = pattern->GetDialog()) {
    _pRadCappingPatternNone = Radio(group, "radCappingPatternNone", 0, 2);
    _pRadCappingPatternMaterial = Radio(group, "radCappingPatternMaterial", 1, 2);
    // The spacer indents the material context check under the material radio.
    Label(group, "lblInvMaterial", 0, 2, 0);
    Check(group, kSlotCappingPatternMaterialContext, "chkCappingPatternMaterialContext", 2, 1, 1,
          0x1E, ioInfo, false);
  }
}

void ZEP2DBaseOptDisplayFrm::BuildDlgAnalysisDisplay(ZEPDlgDialog* iDialog,
                                                     ZEPSettingInfo& ioInfo) {
  struct FrameOf {
    const char* name;
    const char* icon;
    unsigned char (ZEP2DBaseOptDisplayFrm::*with)();
  };
  static const FrameOf frames[] = {
      {"frameDimColor", "I_ColorChooser", nullptr},
      {"frameGeometries", "", &ZEP2DBaseOptDisplayFrm::WithFrmGeometries},
      {"frameCallouts", "", &ZEP2DBaseOptDisplayFrm::WithFrmCallouts},
      {"frameWelding", "", &ZEP2DBaseOptDisplayFrm::WithFrmWelding}};
  for (short f = 0; f < 4; ++f) {
    if (frames[f].with && !(this->*frames[f].with)()) continue;
    ZEPDlgFrame* frame = Section(iDialog, frames[f].name, frames[f].icon, f);
    if (!frame) continue;
    short row = 0;
    for (const StateRow& state : kStateRows) {
      if (state.frame != f) continue;
      const std::string name = state.name;
      ZEPDrwLockCheckButton* check =
          Check(frame, state.state, ("chk" + name).c_str(), row, 0, 1, 0x02, ioInfo, true);
      if (!check) continue;
      ZEPDrwLockComboColor* combo =
          ColorCombo(frame, state.color, ("cmb" + name).c_str(), row, 1, 0x04, ioInfo);
      ++row;
      if (combo->GetCombo()) combo->GetCombo()->SetLongHelp(check->GetLongHelp());
      Services::UpdateCheckButton(check, _bFlag[state.state]);
      ShowColor(state.color);
      Enable(combo, _bFlag[state.state] != 0);
    }
  }
  if (!WithFrmPatterns()) return;
  ZEPDlgFrame* frame = Section(iDialog, "framePatterns", "", 4);
  if (!frame) return;
  Check(frame, kSlotPatternContourPitch, "chkPatternContourPitch", 0, 0, 1, 0x02, ioInfo, false);
  GetSysPatternContourPitchThicknessInfo(ioInfo);
  _pCmbPatternContourPitch =
      new ZEPDrwLockComboWeight(frame, "cmbPatternContourPitch", ioInfo, 1, 0);
  _pCmbPatternContourPitch->SetGridConstraints(0, 1, 1, 1, 0x04);
  _pCmbPatternContourPitch->SetVisibleTextHeight(8);
  _pCmbPatternContourPitch->SetVisibleTextWidth(8);
  if (ZEPComboWeight* weights = _pCmbPatternContourPitch->GetCombo())
    AddAnalyseNotificationCB(weights, weights->GetCombo()->GetComboSelectNotification(),
                             &ZEP2DBaseOptDisplayFrm::Write, nullptr);
  Services::UpdateCheckButton(_pChk[kSlotPatternContourPitch], _bFlag[kSlotPatternContourPitch]);
  const int thickness = _iValue[kSlotPatternContourPitchThickness];
  Services::UpdateComboThickness(_pCmbPatternContourPitch,
                                 static_cast<unsigned int>(thickness < 0 ? 0 : thickness));
  UpdateDependants(kSlotPatternContourPitch);
}

void ZEP2DBaseOptDisplayFrm::BuildDlgVisuDiagColor(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo) {
  ZEPDlgFrame* frame = Section(iDialog, "frameButtonDiagColors", "I_ColorChooser", 0);
  if (!frame) return;
  short row = 0;
  for (const DiagRow& diag : kDiagRows) {
    if ((this->*Hooks(diag.slot).info)(ioInfo) != 0) continue;
    const std::string name = diag.name;
    Label(frame, ("label" + name).c_str(), 1, row, 0);
    ColorCombo(frame, diag.slot, ("cmb" + name).c_str(), row, 1, 0x1E, ioInfo);
    ++row;
    ShowColor(diag.slot);
  }
}

// ---- values -------------------------------------------------------------------------------------
void ZEP2DBaseOptDisplayFrm::Initialize() {
  for (int slot = 0; slot < kSlotCount; ++slot) {
    const ColorHooks& h = ColorHooksOf(slot);
    if (auto get = Hooks(slot).get)
      (this->*get)(_bFlag[slot]);
    else if (h.getInt)
      (this->*h.getInt)(_iValue[slot]);
    else if (h.getColor)
      (this->*h.getColor)(_iColor[slot][0], _iColor[slot][1], _iColor[slot][2]);
    else if (h.getUColor)
      (this->*h.getUColor)(_uColor[slot][0], _uColor[slot][1], _uColor[slot][2]);
  }
  UpdateWidgets();
}

void ZEP2DBaseOptDisplayFrm::ShowColor(int iSlot) {
  if (ColorHooksOf(iSlot).getUColor)
    Services::UpdateComboColor(_pCmbColor[iSlot], _uColor[iSlot][0], _uColor[iSlot][1],
                               _uColor[iSlot][2]);
  else
    Services::UpdateComboColor(_pCmbColor[iSlot], _iColor[iSlot][0], _iColor[iSlot][1],
                               _iColor[iSlot][2]);
}

// Only the page's own controls: the dialogs show the cache when they are built.
void ZEP2DBaseOptDisplayFrm::UpdateWidgets() {
  for (int slot = 0; slot <= kSlotDimAnalysisDisplay; ++slot) {
    Services::UpdateCheckButton(_pChk[slot], _bFlag[slot]);
    UpdateDependants(slot);
  }
  for (int slot : {kSlotVisuDiagnostic, kSlotBackgroundInViewFrame}) {
    Services::UpdateCheckButton(_pChk[slot], _bFlag[slot]);
    UpdateDependants(slot);
  }
  if (_pRadBackgroundInViewFrameAuto && _pRadBackgroundInViewFrameDemand) {
    _pRadBackgroundInViewFrameAuto->SetState(ZEPDlgChecked, 0);
    if (_iValue[kSlotBackgroundInViewFrameMode] == 2)
      _pRadBackgroundInViewFrameDemand->SetState(ZEPDlgChecked, 0);
  }
  if (_pRadCappingColorFix && _pRadCappingColorFromFace) {
    _pRadCappingColorFix->SetState(ZEPDlgChecked, 0);
    if (_iValue[kSlotCappingBackground] == 1) _pRadCappingColorFromFace->SetState(ZEPDlgChecked, 0);
    UpdateDependants(kSlotCappingBackground);
  }
  Services::UpdateCheckButton(_pChk[kSlotCappingColorScale], _bFlag[kSlotCappingColorScale]);
  ShowColor(kSlotCappingColor);
  if (_pRadCappingPatternNone && _pRadCappingPatternMaterial) {
    _pRadCappingPatternNone->SetState(ZEPDlgChecked, 0);
    if (_iValue[kSlotCappingPattern] == 1) _pRadCappingPatternMaterial->SetState(ZEPDlgChecked, 0);
  }
  Services::UpdateCheckButton(_pChk[kSlotCappingPatternMaterialContext],
                              _bFlag[kSlotCappingPatternMaterialContext]);
  UpdateDependants(kSlotCappingPattern);
}

bool ZEP2DBaseOptDisplayFrm::UpdateDependants(int iSlot) {
  switch (iSlot) {
  case kSlotAnnotInSpecTreePlane:
    Enable(_pChk[kSlotAnnotInSpecTreeAnnotSet], _bFlag[iSlot] != 0);
    return true;
  case kSlotDimAnalysisDisplay:
    Enable(_pPushDiagElementsColors, _bFlag[iSlot] != 0);
    return true;
  case kSlotVisuDiagnostic:
    Enable(_pPushDiagGeometriesColors, _bFlag[iSlot] != 0);
    return true;
  case kSlotBackgroundInViewFrame:
    Enable(_pRadBackgroundInViewFrameAuto, _bFlag[iSlot] != 0);
    Enable(_pRadBackgroundInViewFrameDemand, _bFlag[iSlot] != 0);
    return true;
  case kSlotPatternContourPitch:
    Enable(_pCmbPatternContourPitch, _bFlag[iSlot] != 0);
    return true;
  case kSlotCappingBackground:
    Enable(_pCmbColor[kSlotCappingColor], _iValue[iSlot] == 0);
    Enable(_pChk[kSlotCappingColorScale], _iValue[iSlot] == 0);
    return true;
  case kSlotCappingPattern:
    Enable(_pChk[kSlotCappingPatternMaterialContext], _iValue[iSlot] == 1);
    return true;
  default:
    break;
  }
  for (const StateRow& row : kStateRows)
    if (row.state == iSlot) {
      Enable(_pCmbColor[row.color], _bFlag[iSlot] != 0);
      return true;
    }
  return false;
}

void ZEP2DBaseOptDisplayFrm::Write(ZEPCommand* iSender, ZEPNotification*, void*) {
  // Check buttons of the page and of both dialogs.
  for (int slot = 0; slot < kSlotCount; ++slot) {
    if (!Hooks(slot).set ||
        Services::GetValueFromCheckButton(_pChk[slot], iSender, _bFlag[slot]) < 0)
      continue;
    (this->*Hooks(slot).set)(_bFlag[slot]);
    UpdateDependants(slot);
    return;
  }
  // Colour combos; the unsigned colours go through ints that hold 0 to 255 only.
  for (int slot = 0; slot < kSlotCount; ++slot) {
    int rgb[3] = {0, 0, 0};
    if (!_pCmbColor[slot] ||
        Services::GetValueFromComboColor(_pCmbColor[slot], iSender, rgb[0], rgb[1], rgb[2]) < 0)
      continue;
    const ColorHooks& h = ColorHooksOf(slot);
    if (h.setUColor) {
      for (int i = 0; i < 3; ++i)
        _uColor[slot][i] = static_cast<unsigned int>(rgb[i]);
      (this->*h.setUColor)(_uColor[slot][0], _uColor[slot][1], _uColor[slot][2]);
    } else if (h.setColor) {
      for (int i = 0; i < 3; ++i)
        _iColor[slot][i] = rgb[i];
      (this->*h.setColor)(_iColor[slot][0], _iColor[slot][1], _iColor[slot][2]);
    }
    return;
  }
  if (Services::GetValueFromThickness(_pCmbPatternContourPitch, iSender,
                                      _iValue[kSlotPatternContourPitchThickness]) >= 0) {
    SetSysPatternContourPitchThickness(_iValue[kSlotPatternContourPitchThickness]);
    return;
  }
  WriteRadios(iSender);
}

// The radio pairs: the value follows the radios' states, whichever of the two sent, and is
// written only when it changes.
bool ZEP2DBaseOptDisplayFrm::WriteRadios(ZEPCommand* iSender) {
  struct Pair {
    ZEPDlgRadioButton* off;
    ZEPDlgRadioButton* on;
    int slot;
    int offValue, onValue;
  };
  const Pair pairs[] = {
      {_pRadBackgroundInViewFrameAuto, _pRadBackgroundInViewFrameDemand,
       kSlotBackgroundInViewFrameMode, 1, 2},
      {_pRadCappingColorFix, _pRadCappingColorFromFace, kSlotCappingBackground, 0, 1},
      {_pRadCappingPatternNone, _pRadCappingPatternMaterial, kSlotCappingPattern, 0, 1},
  };
  for (const Pair& p : pairs) {
    if (!p.off || !p.on || (iSender != p.off && iSender != p.on)) continue;
    const int value = p.on->GetState() == ZEPDlgChecked ? p.onValue : p.offValue;
    if (value != _iValue[p.slot]) {
      _iValue[p.slot] = value;
      (this->*ColorHooksOf(p.slot).setInt)(_iValue[p.slot]);
    }
    UpdateDependants(p.slot);
    return true;
  }
  return false;
}

// ---- the two dialogs ----------------------------------------------------------------------------
void ZEP2DBaseOptDisplayFrm::NotifPush(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (!iSender) return;
  if (iSender == _pPushDiagElementsColors)
    _dlgAnalysisDisplay.Open(this, &ZEP2DBaseOptDisplayFrm::BuildDlgAnalysisDisplay,
                             &ZEP2DBaseOptDisplayFrm::CloseDlg);
  else if (iSender == _pPushDiagGeometriesColors)
    _dlgVisuDiagColor.Open(this, &ZEP2DBaseOptDisplayFrm::BuildDlgVisuDiagColor,
                           &ZEP2DBaseOptDisplayFrm::CloseDlg);
}

void ZEP2DBaseOptDisplayFrm::CloseDlg(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (!_dlgAnalysisDisplay.Close(iSender)) _dlgVisuDiagColor.Close(iSender);
}
