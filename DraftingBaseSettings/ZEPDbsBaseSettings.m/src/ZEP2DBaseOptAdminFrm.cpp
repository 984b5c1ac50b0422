#include "ZEP2DBaseOptAdminFrm.h"

#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockCombo.h"
#include "ZEPDrwLockEditor.h"
#include "ZEPDrwLockFrame.h"
#include "ZEPDrwLockLabel.h"
#include "ZEPDrwSettingsServices.h"

#include <algorithm>
#include <initializer_list>

#define ZEP_SETTING(Name, Kind) ZEP_DEFINE_SETTING_HOOKS(ZEP2DBaseOptAdminFrm, Name, Kind)
#include "ZEP2DBaseOptAdminFrm.def"
#undef ZEP_SETTING

namespace {
using Services = ZEPDrwSettingsServices;
using Page = ZEP2DBaseOptAdminFrm;

const char* const kCatalog = "ZEP2DBaseOptAdminFrm";

// How a behaviour row maps its stored value to its combo line.
enum Conversion {
  kSame,            // lines 0 1 2 3: line = value
  kShift,           // lines 1 2 3: line = value - 1
  kShiftWithoutGVS, // lines 0 1 2 3 with generative view styles, else 0 2 3
  kShiftAboveZero,  // lines 0 2 3
};

// The values a row offers, in line order.
const char* Lines(Conversion iConversion, bool iWithGVS) {
  switch (iConversion) {
  case kShift:
    return "123";
  case kShiftWithoutGVS:
    return iWithGVS ? "0123" : "023";
  case kShiftAboveZero:
    return "023";
  default:
    return "0123";
  }
}

// The catalog keys of the behaviour values' lines.
const char* const kBehaviorKeys[] = {"fix", "elemtype", "style", "nooverload"};

unsigned long Sensitivity(bool iEnabled) { return iEnabled ? ZEPDlgEnable : ZEPDlgDisable; }

ZEPDlgFrame* Section(ZEPDialog* iPage, const char* iName, const ZEPString& iIcon,
                     unsigned long iStyle, short& ioRow) {
  auto* section = new ZEPDlgToolsOptionsFrame(iPage, iName, iIcon, iStyle);
  section->SetGridConstraints(ioRow++, 0, 1, 1, 0x1E);
  return section->GetOptionsFrame();
}

ZEPDrwLockLabel* Label(ZEPDialog* iFrame, const char* iName, int iWithText, short iRow,
                       short iColumn, short iWidth = 1) {
  auto* label = new ZEPDrwLockLabel(iFrame, iName, iWithText);
  label->SetGridConstraints(iRow, iColumn, iWidth, 1, 0x1E);
  return label;
}
} // namespace

// One row of the behaviour dialog: the property name its hooks and widgets are named after.
struct ZEP2DBaseOptAdminFrm::BehaviorRow {
  const char* name;
  Conversion conversion;
  long (Page::*info)(ZEPSettingInfo&);
  long (Page::*set)(const int&);
  long (Page::*get)(int&);
};

const ZEP2DBaseOptAdminFrm::BehaviorRow& ZEP2DBaseOptAdminFrm::Behavior(int iRow) {
#define ZEP_ROW(Name, Conversion)                                                                  \
  {#Name, Conversion, &Page::GetSys##Name##Info, &Page::SetSys##Name, &Page::GetSys##Name}
  static const BehaviorRow rows[] = {
      ZEP_ROW(DrwTbFontName, kSame),          ZEP_ROW(DrwTbFontSize, kSame),
      ZEP_ROW(DrwTbBold, kSame),              ZEP_ROW(DrwTbItalic, kSame),
      ZEP_ROW(DrwTbUnderOverLine, kSame),     ZEP_ROW(DrwTbStrikeThrough, kSame),
      ZEP_ROW(DrwTbJustification, kSame),     ZEP_ROW(DrwTbAnchorPoint, kSame),
      ZEP_ROW(DrwTbFrame, kShift),            ZEP_ROW(DrwTbSymbol, kShift),
      ZEP_ROW(DrwTbDimensionLine, kShift),    ZEP_ROW(DrwTbTolerances, kSame),
      ZEP_ROW(DrwTbNumDispDesc, kShift),      ZEP_ROW(DrwTbPrecision, kSame),
      ZEP_ROW(DrwTbColor, kShiftWithoutGVS),  ZEP_ROW(DrwTbThickness, kShiftWithoutGVS),
      ZEP_ROW(DrwTbLineType, kShiftWithoutGVS), ZEP_ROW(DrwTbPointType, kShiftWithoutGVS),
      ZEP_ROW(DrwTbPattern, kShiftAboveZero),
  };
#undef ZEP_ROW
  static_assert(sizeof rows / sizeof rows[0] == kBehaviorCount, "one row per behaviour hook");
  return rows[iRow];
}

const ZEPSettingSlotHooks<ZEP2DBaseOptAdminFrm>& ZEP2DBaseOptAdminFrm::Hooks(int iSlot) {
  static const ZEPSettingSlotHooks<ZEP2DBaseOptAdminFrm> hooks[] = {
#define ZEP_SETTING(Name, Kind) ZEP_SETTING_SLOT_HOOKS(ZEP2DBaseOptAdminFrm, Name, Kind)
#include "ZEP2DBaseOptAdminFrm.def"
#undef ZEP_SETTING
  };
  static_assert(sizeof hooks / sizeof hooks[0] == kSlotCount, "one row of hooks per attribute");
  return hooks[iSlot];
}

ZEP2DBaseOptAdminFrm::ZEP2DBaseOptAdminFrm(ZEPDialog* iParent, const ZEPString& iName)
    : ZEPDlgFrame(iParent, iName, 0x80001) {
  for (ZEPDrwLockCombo*& combo : _pCmbBehavior)
    _dlgPropTbBehavior.Track(combo);
}

ZEP2DBaseOptAdminFrm::~ZEP2DBaseOptAdminFrm() {
  for (ZEPDrwLockCheckButton*& check : _pChk)
    check = nullptr;
  for (ZEPDrwLockCombo*& combo : _pCmbBehavior)
    combo = nullptr;
  _pPushPropTbBehavior = nullptr;
  _pEdtFolderTitleBlock = nullptr;
  _pRadElemUnderCurAssemblyRoot = _pRadElemUnderCurFavContextRoot = _pRadAnyRelevantElement =
      nullptr;
  _pRadSelectedAssGeom = _pRadSelectedAssGeomWithAnnotation = nullptr;
  _pRadViewNameUnicityInSheet = _pRadViewNameUnicityInLayout = nullptr;
}

ZEPString ZEP2DBaseOptAdminFrm::GetResourceFilename(int iIndex) const {
  if (iIndex >= 1) return ZEPDlgFrame::GetResourceFilename(iIndex - 1);
  return kCatalog;
}

// ---- widget tree ------------------------------------------------------------------------------
// The caller has filled ioInfo through the attribute's info hook.
ZEPDrwLockCheckButton* ZEP2DBaseOptAdminFrm::Check(ZEPDialog* iFrame, int iSlot, const char* iName,
                                                   short iRow, short iColumn, short iWidth,
                                                   ZEPSettingInfo& ioInfo) {
  auto* check = new ZEPDrwLockCheckButton(iFrame, iName, ioInfo, 0);
  check->SetGridConstraints(iRow, iColumn, iWidth, 1, 0x1E);
  AddAnalyseNotificationCB(check->GetDialog(), check->GetChkBModifyNotification(),
                           &ZEP2DBaseOptAdminFrm::Write, nullptr);
  return _pChk[iSlot] = check;
}

void ZEP2DBaseOptAdminFrm::CheckIf(ZEPDialog* iFrame, int iSlot, const char* iName, short& ioRow,
                                   short iWidth, bool iExactlyZero, ZEPSettingInfo& ioInfo) {
  const long status = Info(iSlot, ioInfo);
  if (iExactlyZero ? status != 0 : status < 0) return;
  Check(iFrame, iSlot, iName, ioRow++, 0, iWidth, ioInfo);
}

ZEPDlgRadioButton* ZEP2DBaseOptAdminFrm::Radio(ZEPDialog* iGroup, const char* iName, short iRow,
                                               short iColumn, const ZEPUnicodeString* iLongHelp) {
  auto* radio = new ZEPDlgRadioButton(iGroup, iName, 0);
  radio->SetGridConstraints(iRow, iColumn, 1, 1, 0x1E);
  if (iLongHelp) radio->SetLongHelp(*iLongHelp);
  AddAnalyseNotificationCB(radio, radio->GetRadBModifyNotification(), &ZEP2DBaseOptAdminFrm::Write,
                           nullptr);
  return radio;
}

void ZEP2DBaseOptAdminFrm::Build(unsigned char iNoStyles) {
  ZEPSettingInfo info;
  short frameRow = 0;

  // Drawing management: only the checks whose settings the host knows (status not negative).
  ZEPDlgFrame* management = Section(this, "toolDrwMng", GetFrameIconName(), 4, frameRow);
  short row = 0;
  CheckIf(management, kSlotPrevSwitchStd, "checkSwitchStandard", row, 2, false, info);
  CheckIf(management, kSlotPrevUpdateStd, "checkUpdateStandard", row, 2, false, info);
  CheckIf(management, kSlotPrevBackgroundAccess, "checkBackgroundView", row, 2, false, info);
  CheckIf(management, kSlotPreventRootUpgrade, "chkPreventRootUpgrade", row, 2, false, info);
  if (Info(kSlotPreventViewUpgrade, info) >= 0) {
    Check(management, kSlotPreventViewUpgrade, "chkPreventViewUpgrade", row++, 0, 2, info);
    // Indented under the view upgrade check, on a row of its own.
    Label(management, "lblInv", 0, row, 0);
    Info(kSlotPrevViewGeomUpgrade, info);
    Check(management, kSlotPrevViewGeomUpgrade, "chkPrevViewGeomUpgrade", row++, 1, 1, info);
  }
  if (!iNoStyles) {
    CheckIf(management, kSlotDisableTemplateCreation, "chkDisableTemplateCreation", row, 2, false,
            info);
    CheckIf(management, kSlotDisableGenMfgRequirements, "chkDisableGenMfgRequirements", row, 2,
            false, info);
  }

  if (WithFrmTitleBlock()) {
    ZEPDlgFrame* titleBlock = Section(this, "frameTitleBlock", "I_D3M_FrameTitleBlock", 4, frameRow);
    Info(kSlotFolderTitleBlock, info);
    _pEdtFolderTitleBlock = new ZEPDrwLockEditor(titleBlock, "FrameAndTitleBlockPath", info, 0);
    _pEdtFolderTitleBlock->SetGridConstraints(0, 0, 1, 1, 0x1E);
    if (ZEPDlgEditor* editor = _pEdtFolderTitleBlock->GetEditor()) {
      editor->SetVisibleTextWidth(25);
      AddAnalyseNotificationCB(editor, editor->GetEditModifyNotification(),
                               &ZEP2DBaseOptAdminFrm::Write, nullptr);
    }
  }

  if (!iNoStyles) {
    ZEPDlgFrame* styles = Section(this, "toolDrwStyle", "", 6, frameRow);
    auto* behavior = new ZEPDlgFrame(styles, "frmPropTbBehavior", 0x80001);
    behavior->SetGridConstraints(0, 0, 3, 1, 0x1E);
    Label(behavior, "lblPropTbBehaviorBtn", 1, 0, 0);
    _pPushPropTbBehavior = new ZEPDlgPushButton(behavior, "pushPropTbBehavior", 0);
    _pPushPropTbBehavior->SetGridConstraints(0, 1, 1, 1, 0x1E);
    AddAnalyseNotificationCB(_pPushPropTbBehavior,
                             _pPushPropTbBehavior->GetPushBActivateNotification(),
                             &ZEP2DBaseOptAdminFrm::NotifPush, nullptr);
    Info(kSlotUseStyleCreateObjects, info);
    Check(styles, kSlotUseStyleCreateObjects, "chkStyleCreation", 1, 0, 3, info);
    Info(kSlotDisplayResetButton, info);
    Check(styles, kSlotDisplayResetButton, "chkReset", 2, 0, 3, info);
  }

  if (WithFrmGVS()) {
    ZEPDlgFrame* gvs = Section(this, "toolGVS", "", 6, frameRow);
    Info(kSlotPrevGenViewStyle, info);
    Check(gvs, kSlotPrevGenViewStyle, "chkPreventGVS", 0, 0, 3, info);
    Label(gvs, "lblInv", 0, 1, 0);
    Info(kSlotGVSParamOverride, info);
    Check(gvs, kSlotGVSParamOverride, "chkGVSParamOverride", 1, 1, 1, info);
  }

  ZEPDlgFrame* annotation = Section(this, "toolAnnotation", "I_D3M_Lock", 4, frameRow);
  Info(kSlotDisableAnnotLockEditionPropAccess, info);
  Check(annotation, kSlotDisableAnnotLockEditionPropAccess, "chkDisableAnnotLockEditionPropAccess",
        0, 0, 1, info);

  // Name unicity: only the settings whose info hook answers exactly 0.
  ZEPDlgFrame* naming = Section(this, "toolsNamingUnicity", "", 6, frameRow);
  row = 0;
  CheckIf(naming, kSlotSheetNamesUnicity, "checkSheetNamesUnicity", row, 1, true, info);
  CheckIf(naming, kSlotViewNamesUnicity, "checkViewNamesUnicity", row, 1, true, info);
  if (Info(kSlotViewNameUnicityScope, info) == 0) {
    auto* scope = new ZEPDrwLockFrame(naming, "frmViewNameUnicityScope", info, 0x80001);
    scope->SetGridConstraints(row++, 0, 1, 1, 0x1E);
    if (ZEPDialog* group = scope->GetDialog()) {
      Label(group, "invLock2", 0, 0, 0);
      _pRadViewNameUnicityInSheet = Radio(group, "radViewNameUnicityInSheet", 0, 1, nullptr);
      _pRadViewNameUnicityInLayout = Radio(group, "radViewNameUnicityInLayout", 1, 1, nullptr);
    }
  }
  CheckIf(naming, kSlotFilterNamesUnicity, "checkFilterNamesUnicity", row, 1, true, info);
  CheckIf(naming, kSlotCaptureNamesUnicity, "chkCaptureNamesUnicity", row, 1, true, info);
  CheckIf(naming, kSlotDistinguishCodeInUnicity, "chkDistinguishCodeInUnicity", row, 1, true, info);
  CheckIf(naming, kSlotDistinguishCaseInUnicity, "chkDistinguishCaseInUnicity", row, 1, true, info);

  if (WithFrmAssemblyMgmt()) {
    ZEPDlgFrame* assembly = Section(this, "toolAssemblyMgmt", "", 6, frameRow);
    const ZEPUnicodeString allowHelp =
        Label(assembly, "LblAllowSelectionOf", 1, 0, 0, 3)->GetLongHelp();
    Label(assembly, "LblInv", 0, 1, 1);
    Info(kSlotSelectionOnCurrentAssembly, info);
    auto* scope = new ZEPDrwLockFrame(assembly, "frmSelectionOnCurrentAssembly", info, 0x80001);
    scope->SetGridConstraints(1, 2, 1, 1, 0x1E);
    if (ZEPDialog* group = scope->GetDialog()) {
      _pRadElemUnderCurAssemblyRoot = Radio(group, "radElemUnderCurAssemblyRoot", 0, 0, &allowHelp);
      _pRadElemUnderCurFavContextRoot =
          Radio(group, "radElemUnderCurFavContextRoot", 1, 0, &allowHelp);
      _pRadAnyRelevantElement = Radio(group, "radAnyRelevantElement", 2, 0, &allowHelp);
    }
    const ZEPUnicodeString warningHelp =
        Label(assembly, "lblShowWarning", 1, 2, 0, 3)->GetLongHelp();
    Info(kSlotShowWarningSelectionOutAssembly, info);
    Check(assembly, kSlotShowWarningSelectionOutAssembly, "chkShowWarningSelectionOutAssembly", 3,
          2, 1, info)
        ->SetLongHelp(warningHelp);
    Info(kSlotShowWarningSelectionOutFavoriteContext, info);
    Check(assembly, kSlotShowWarningSelectionOutFavoriteContext,
          "chkShowWarningSelectionOutFavoriteContext", 4, 2, 1, info)
        ->SetLongHelp(warningHelp);
    if (Info(kSlotEnggConLocation, info) == 0) {
      const ZEPUnicodeString locationHelp =
          Label(assembly, "LblEngineeringConnectionLocation", 1, 5, 0, 3)->GetLongHelp();
      auto* location =
          new ZEPDrwLockFrame(assembly, "frmEngineeringConnectionLocation", info, 0x80001);
      location->SetGridConstraints(6, 2, 1, 1, 0x1E);
      if (ZEPDialog* group = location->GetDialog()) {
        _pRadSelectedAssGeom = Radio(group, "radSelectedAssGeom", 0, 0, &locationHelp);
        _pRadSelectedAssGeomWithAnnotation =
            Radio(group, "radSelectedAssGeomWithAnnotation", 1, 0, &locationHelp);
      }
    }
  }

  if (ZEPGetEnv("ZEP_TDE_LA")) {
    ZEPDlgFrame* dress = Section(this, "toolDress", "", 6, frameRow);
    GetSysPrevTrueDim(_bFlag[kSlotPrevTrueDim]);
    // Its own lock state, not the record of the control built before it.
    Info(kSlotPrevTrueDim, info);
    Check(dress, kSlotPrevTrueDim, "chkPrevTrueDim", 0, 0, 1, info);
  }
}

// ---- values -------------------------------------------------------------------------------------
int ZEP2DBaseOptAdminFrm::IndexOfBehavior(int iRow, int iValue) {
  switch (Behavior(iRow).conversion) {
  case kShift:
    return iValue - 1;
  case kShiftWithoutGVS:
    return !WithFrmGVS() && iValue > 0 ? iValue - 1 : iValue;
  case kShiftAboveZero:
    return iValue > 0 ? iValue - 1 : iValue;
  default:
    return iValue;
  }
}

int ZEP2DBaseOptAdminFrm::BehaviorOfIndex(int iRow, int iIndex) {
  switch (Behavior(iRow).conversion) {
  case kShift:
    return iIndex + 1;
  case kShiftWithoutGVS:
    return !WithFrmGVS() && iIndex > 0 ? iIndex + 1 : iIndex;
  case kShiftAboveZero:
    return iIndex > 0 ? iIndex + 1 : iIndex;
  default:
    return iIndex;
  }
}

void ZEP2DBaseOptAdminFrm::Initialize() {
  auto readFlags = [this](int iFirst, int iLast) {
    for (int slot = iFirst; slot <= iLast; ++slot)
      (this->*Hooks(slot).get)(_bFlag[slot]);
  };
  readFlags(kSlotPrevSwitchStd, kSlotGVSParamOverride);
  readFlags(kSlotShowWarningSelectionOutAssembly, kSlotDisableGenMfgRequirements);
  for (int i = 0; i < kBehaviorCount; ++i) {
    int value = 0;
    (this->*Behavior(i).get)(value);
    _iBehavior[i] = IndexOfBehavior(i, value);
  }
  GetSysSelectionOnCurrentAssembly(_iSelectionOnCurrentAssembly);
  readFlags(kSlotDisableAnnotLockEditionPropAccess, kSlotDisableAnnotLockEditionPropAccess);
  GetSysFolderTitleBlock(_folderTitleBlock);
  readFlags(kSlotSheetNamesUnicity, kSlotCaptureNamesUnicity);
  GetSysViewNameUnicityScope(_iViewNameUnicityScope);
  readFlags(kSlotDistinguishCodeInUnicity, kSlotDistinguishCaseInUnicity);
  GetSysEnggConLocation(_iEnggConLocation);
  UpdateWidgets();
}

void ZEP2DBaseOptAdminFrm::SetEnabled(ZEPDrwLockCheckButton* iCheck, bool iEnabled) {
  if (iCheck) iCheck->SetSensitivity(Sensitivity(iEnabled));
}

void ZEP2DBaseOptAdminFrm::UpdateWidgets() {
  auto show = [this](std::initializer_list<int> iSlots) {
    for (int slot : iSlots)
      Services::UpdateCheckButton(_pChk[slot], _bFlag[slot]);
  };
  show({kSlotPrevSwitchStd, kSlotPrevUpdateStd, kSlotPrevBackgroundAccess,
        kSlotUseStyleCreateObjects});
  if (_pEdtFolderTitleBlock && _pEdtFolderTitleBlock->GetEditor())
    _pEdtFolderTitleBlock->GetEditor()->SetText(_folderTitleBlock, 0);
  show({kSlotPrevGenViewStyle});
  SetEnabled(_pChk[kSlotGVSParamOverride],
             !(_bFlag[kSlotPrevGenViewStyle] && _pChk[kSlotPrevGenViewStyle]));
  show({kSlotGVSParamOverride, kSlotDisableAnnotLockEditionPropAccess, kSlotSheetNamesUnicity,
        kSlotViewNamesUnicity, kSlotFilterNamesUnicity, kSlotCaptureNamesUnicity,
        kSlotDistinguishCodeInUnicity, kSlotDistinguishCaseInUnicity});
  if (_pRadViewNameUnicityInSheet && _pRadViewNameUnicityInLayout) {
    _pRadViewNameUnicityInLayout->SetState(ZEPDlgChecked, 0);
    if (_iViewNameUnicityScope == 0) _pRadViewNameUnicityInSheet->SetState(ZEPDlgChecked, 0);
    const unsigned long sensitivity = Sensitivity(_bFlag[kSlotViewNamesUnicity]);
    _pRadViewNameUnicityInSheet->SetSensitivity(sensitivity);
    _pRadViewNameUnicityInLayout->SetSensitivity(sensitivity);
  }
  show({kSlotDisplayResetButton, kSlotPrevTrueDim, kSlotPreventRootUpgrade,
        kSlotPreventViewUpgrade, kSlotDisableTemplateCreation, kSlotDisableGenMfgRequirements});
  SetEnabled(_pChk[kSlotPrevViewGeomUpgrade],
             !(_bFlag[kSlotPreventViewUpgrade] && _pChk[kSlotPreventViewUpgrade]));
  show({kSlotPrevViewGeomUpgrade});
  if (_pRadElemUnderCurAssemblyRoot && _pRadElemUnderCurFavContextRoot && _pRadAnyRelevantElement) {
    ZEPDlgRadioButton* radios[] = {_pRadElemUnderCurAssemblyRoot, _pRadElemUnderCurFavContextRoot,
                                   _pRadAnyRelevantElement};
    if (_iSelectionOnCurrentAssembly >= 0 && _iSelectionOnCurrentAssembly <= 2)
      radios[_iSelectionOnCurrentAssembly]->SetState(ZEPDlgChecked, 0);
  }
  show({kSlotShowWarningSelectionOutAssembly, kSlotShowWarningSelectionOutFavoriteContext});
  if (_pRadSelectedAssGeom && _pRadSelectedAssGeomWithAnnotation) {
    if (_iEnggConLocation == 0) _pRadSelectedAssGeom->SetState(ZEPDlgChecked, 0);
    if (_iEnggConLocation == 1) _pRadSelectedAssGeomWithAnnotation->SetState(ZEPDlgChecked, 0);
  }
  UpdateShowWarningCheckButtons();
  UpdateDistinguish();
}

void ZEP2DBaseOptAdminFrm::UpdateShowWarningCheckButtons() {
  SetEnabled(_pChk[kSlotShowWarningSelectionOutAssembly], _iSelectionOnCurrentAssembly >= 1);
  SetEnabled(_pChk[kSlotShowWarningSelectionOutFavoriteContext],
             !_bFlag[kSlotShowWarningSelectionOutAssembly] && _iSelectionOnCurrentAssembly == 2);
}

// Code and case distinguish names only where some names must be unique.
void ZEP2DBaseOptAdminFrm::UpdateDistinguish() {
  bool any = false;
  for (int slot : {kSlotSheetNamesUnicity, kSlotViewNamesUnicity, kSlotFilterNamesUnicity,
                   kSlotCaptureNamesUnicity})
    any = any || (_pChk[slot] && _bFlag[slot]);
  SetEnabled(_pChk[kSlotDistinguishCodeInUnicity], any);
  SetEnabled(_pChk[kSlotDistinguishCaseInUnicity], any);
}

void ZEP2DBaseOptAdminFrm::Write(ZEPCommand* iSender, ZEPNotification*, void*) {
  [&] {
    for (int slot = 0; slot < kSlotCount; ++slot) {
      if (!Hooks(slot).set ||
          Services::GetValueFromCheckButton(_pChk[slot], iSender, _bFlag[slot]) < 0)
        continue;
      (this->*Hooks(slot).set)(_bFlag[slot]);
      const bool on = _bFlag[slot] != 0;
      switch (slot) {
      case kSlotPrevGenViewStyle:
        SetEnabled(_pChk[kSlotGVSParamOverride], !on);
        break;
      case kSlotPreventViewUpgrade:
        SetEnabled(_pChk[kSlotPrevViewGeomUpgrade], !on);
        break;
      case kSlotShowWarningSelectionOutAssembly:
        UpdateShowWarningCheckButtons();
        break;
      case kSlotViewNamesUnicity:
        for (ZEPDlgRadioButton* radio : {_pRadViewNameUnicityInSheet, _pRadViewNameUnicityInLayout})
          if (radio) radio->SetSensitivity(Sensitivity(on));
        break;
      case kSlotDisableTemplateCreation:
        SendRestartMsg(); // whichever way it was toggled
        break;
      default:
        break;
      }
      return;
    }
    ZEPDlgEditor* editor = _pEdtFolderTitleBlock ? _pEdtFolderTitleBlock->GetEditor() : nullptr;
    if (editor && iSender == editor) {
      const ZEPUnicodeString old = _folderTitleBlock;
      _folderTitleBlock = editor->GetText();
      if (!(_folderTitleBlock == old)) SetSysFolderTitleBlock(_folderTitleBlock);
      return;
    }
    for (int i = 0; i < kBehaviorCount; ++i) {
      if (Services::GetValueFromCombo(_pCmbBehavior[i], iSender, _iBehavior[i]) < 0) continue;
      const int value = BehaviorOfIndex(i, _iBehavior[i]);
      (this->*Behavior(i).set)(value);
      return;
    }
    WriteRadios(iSender);
  }();
  UpdateDistinguish();
}

// A click on a radio notifies the radio turned off, then the one turned on: both find the
// same new value, so the setting is written once.
bool ZEP2DBaseOptAdminFrm::WriteRadios(ZEPCommand* iSender) {
  if (!iSender) return false;
  auto on = [](ZEPDlgRadioButton* iRadio) { return iRadio->GetState() == ZEPDlgChecked; };
  if (_pRadViewNameUnicityInSheet && _pRadViewNameUnicityInLayout &&
      (iSender == _pRadViewNameUnicityInSheet || iSender == _pRadViewNameUnicityInLayout)) {
    const int scope = on(_pRadViewNameUnicityInLayout) ? 1 : 0;
    if (scope != _iViewNameUnicityScope) {
      _iViewNameUnicityScope = scope;
      SetSysViewNameUnicityScope(_iViewNameUnicityScope);
    }
    return true;
  }
  if (_pRadElemUnderCurAssemblyRoot && _pRadElemUnderCurFavContextRoot && _pRadAnyRelevantElement &&
      (iSender == _pRadElemUnderCurAssemblyRoot || iSender == _pRadElemUnderCurFavContextRoot ||
       iSender == _pRadAnyRelevantElement)) {
    const int scope = on(_pRadElemUnderCurAssemblyRoot)     ? 0
                      : on(_pRadElemUnderCurFavContextRoot) ? 1
                                                            : 2;
    if (scope != _iSelectionOnCurrentAssembly) {
      _iSelectionOnCurrentAssembly = scope;
      SetSysSelectionOnCurrentAssembly(_iSelectionOnCurrentAssembly);
    }
    UpdateShowWarningCheckButtons();
    return true;
  }
  if (_pRadSelectedAssGeom && _pRadSelectedAssGeomWithAnnotation &&
      (iSender == _pRadSelectedAssGeom || iSender == _pRadSelectedAssGeomWithAnnotation)) {
    int location = _iEnggConLocation;
    if (on(_pRadSelectedAssGeom))
      location = 0;
    else if (on(_pRadSelectedAssGeomWithAnnotation))
      location = 1;
    if (location != _iEnggConLocation) {
      _iEnggConLocation = location;
      SetSysEnggConLocation(_iEnggConLocation);
    }
    return true;
  }
  return false;
}

// Tells the administrator that disabling template creation takes effect at the next start.
void ZEP2DBaseOptAdminFrm::SendRestartMsg() {
  auto* box = new ZEPVidFraMessageBox(this, "ZEP2DBaseOptAdminFrmMsg");
  box->SetStandardButtons(32);
  box->SetEscapeButton(32);
  box->SetDefaultButton(32);
  box->SetActionIcon(3);
  box->SetActiveFlag(true);
  box->SetCompactFlag(false);
  box->SetAutoCloseFlag(true);
  box->SetVisibleFlag(true);
  box->SetModalFlag(true);
  box->SetTitle(ZEPMsgCatalog::BuildMessage(kCatalog, "DisableTemplateCreationWng.Title"));
  box->SetInformativeText(
      ZEPMsgCatalog::BuildMessage(kCatalog, "DisableTemplateCreationWng.Message"));
}

// ---- property toolbar behaviour dialog ----------------------------------------------------------
void ZEP2DBaseOptAdminFrm::NotifPush(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (iSender && iSender == _pPushPropTbBehavior)
    _dlgPropTbBehavior.Open(this, &ZEP2DBaseOptAdminFrm::BuildDlgPropTbBehavior,
                            &ZEP2DBaseOptAdminFrm::CloseDlg);
}

namespace {
const char* const kPlaceKeys[] = {"dlgPropTbBehaviorX", "dlgPropTbBehaviorY",
                                  "dlgPropTbBehaviorWidth", "dlgPropTbBehaviorHeight"};
} // namespace

void ZEP2DBaseOptAdminFrm::BuildDlgPropTbBehavior(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo) {
  if (!iDialog) return;
  if (ZEPSysPreferenceRepository* rep =
          ZEPSysPreferenceRepository::GetPreferenceRepository("DraftingOptions")) {
    int place[4] = {440, 240, 440, 595};
    for (int i = 0; i < 4; ++i)
      rep->ReadPreference(kPlaceKeys[i], &place[i], 1);
    // A width or height of 0 or less would open a dialog no one can see: keep the default.
    if (place[2] <= 0 || place[3] <= 0) {
      const int defaults[4] = {440, 240, 440, 595};
      std::copy(defaults, defaults + 4, place);
    }
    iDialog->SetRectDimensions(ZEPRect{place[0], place[1], place[2], place[3]}, 0);
  }
  iDialog->SetGridColumnResizable(0, 1);
  iDialog->SetGridRowResizable(0, 1);
  auto* container = new ZEPDlgContainer(iDialog, "dlgContainer", 1);
  container->SetGridConstraints(0, 0, 1, 1, 0x1E);
  auto* section = new ZEPDlgToolsOptionsFrame(container, "framePropTbBehavior", "", 6);
  section->SetGridConstraints(0, 0, 1, 1, 0x1E);
  ZEPDlgFrame* frame = section->GetOptionsFrame();
  if (!frame) return;

  ZEPUnicodeString lines[4];
  for (int i = 0; i < 4; ++i)
    lines[i] = ZEPMsgCatalog::BuildMessage(kCatalog, kBehaviorKeys[i]);
  Label(frame, "lblPropertyName", 1, 0, 0);
  Label(frame, "lblPropertyBehavior", 1, 0, 1);
  frame->SetGridColumnResizable(0, 1);
  frame->SetGridColumnResizable(1, 1);

  short row = 1;
  for (int i = 0; i < kBehaviorCount; ++i) {
    const BehaviorRow& r = Behavior(i);
    if ((this->*r.info)(ioInfo) != 0) continue;
    Label(frame, (ZEPString("lbl") + r.name).c_str(), 1, row, 0);
    auto* combo = new ZEPDrwLockCombo(frame, ZEPString("cmb") + r.name, ioInfo, 0x40000);
    combo->SetGridConstraints(row++, 1, 1, 1, 0x1E);
    _pCmbBehavior[i] = combo;
    if (ZEPDlgCombo* inner = combo->GetCombo()) {
      inner->ClearLine();
      const bool withGVS = r.conversion == kShiftWithoutGVS && WithFrmGVS();
      for (const char* v = Lines(r.conversion, withGVS); *v; ++v)
        inner->SetLine(lines[*v - '0'], -1, 0x40);
      inner->SetVisibleTextWidth(17);
      AddAnalyseNotificationCB(combo->GetDialog(), inner->GetComboSelectNotification(),
                               &ZEP2DBaseOptAdminFrm::Write, nullptr);
    }
    Services::UpdateCombo(_pCmbBehavior[i], static_cast<unsigned int>(_iBehavior[i]));
  }
}

void ZEP2DBaseOptAdminFrm::CloseDlg(ZEPCommand* iSender, ZEPNotification*, void*) {
  ZEPDlgDialog* dialog = _dlgPropTbBehavior.GetDialog();
  if (!dialog || iSender != dialog) return;
  ZEPRect rect;
  dialog->GetRectDimensions(&rect);
  if (ZEPSysPreferenceRepository* rep = GetDlgPreferenceRepository()) {
    const int place[4] = {rect.x, rect.y, rect.dx, rect.dy};
    int written = 0;
    while (written < 4 && rep->WritePreference(kPlaceKeys[written], &place[written], 1) == 1)
      ++written;
    if (written == 4) rep->SaveRepository(nullptr);
  }
  _dlgPropTbBehavior.Close(iSender);
}
