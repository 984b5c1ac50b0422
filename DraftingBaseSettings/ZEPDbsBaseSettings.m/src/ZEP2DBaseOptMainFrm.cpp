#include "ZEP2DBaseOptMainFrm.h"

#include "ZEP2DBaseRangeCmb.h"
#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockCombo.h"
#include "ZEPDrwLockFrame.h"
#include "ZEPDrwLockLabel.h"
#include "ZEPDrwLockPushButton.h"
#include "ZEPDrwSettingsServices.h"

#include <cmath>
#include <cstdio>

#define ZEP_SETTING(Name, Kind) ZEP_DEFINE_SETTING_HOOKS(ZEP2DBaseOptMainFrm, Name, Kind)
#include "ZEP2DBaseOptMainFrm.def"
#undef ZEP_SETTING

namespace {
using Services = ZEPDrwSettingsServices;

const char* const kPath = "DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEP2DBaseOptMainFrm";
const char* const kFolderIcon = "I_D3M_Folder";
const char* const kDatabaseIcon = "I_D3M_Database";

unsigned long Sensitivity(bool iEnabled) { return iEnabled ? ZEPDlgEnable : ZEPDlgDisable; }

// The PLM flag as stored; 0 when the hook fails.
template <class Page, class Getter> unsigned char ReadFlag(Page* iPage, Getter iGetter) {
  unsigned char flag = 0;
  if (FAILED((iPage->*iGetter)(flag))) flag = 0;
  return flag;
}
} // namespace

ZEP2DBaseOptMainFrm::ZEP2DBaseOptMainFrm(ZEPDialog* iParent, const ZEPString& iName)
    : ZEPDlgFrame(iParent, iName, 0x80001) {
  // The length factors of the ranges: one model unit per paper unit at each range.
  const double ratio[kRangeCount] = {1.0, 100.0, 10000.0, 0.01, 0.0001};
  for (int i = 0; i < kRangeCount; ++i)
    _dScaleRatio[i] = ratio[i];
}

ZEP2DBaseOptMainFrm::~ZEP2DBaseOptMainFrm() {
  _pMainFrame = nullptr;
  _cmbStandardName = nullptr;
  _pChkInsertDrawing = _pChkMakeDrawingShareable = nullptr;
  _pPushStandardPLMAdd = _pPushStandardPLMRemove = nullptr;
  _pEdtScaleRatio = _pEdtScaleRatioDec = nullptr;
  _pCmbRatioRange = nullptr;
  // A chooser still open must not keep this page as the father of its command.
  if (_pPLMObjectChooser) {
    if (ZEPCommand* command = _pPLMObjectChooser->GetCommand()) command->SetFather(nullptr);
    _pPLMObjectChooser->SetVisibility(ZEPDlgHide);
    ReleasePLMChooser();
  }
}

ZEPString ZEP2DBaseOptMainFrm::GetResourceFilename(int iIndex) const {
  if (iIndex >= 1) return ZEPDlgFrame::GetResourceFilename(iIndex - 1);
  return "ZEP2DBaseOptMainFrm";
}

void ZEP2DBaseOptMainFrm::GetListOfStandardTypedFolder(ZEPListValZEPUnicodeString& oNames) {
  oNames.RemoveAll(1);
  Services::GetXmlFilesNames("drafting", 0, oNames);
}

// ---- widget tree ------------------------------------------------------------------------------
int ZEP2DBaseOptMainFrm::Build() {
  GetListOfStandardTypedFolder(_lstStdFolder);

  auto* options = new ZEPDlgToolsOptionsFrame(this, "MainFrm", GetFrameIconName(), 4);
  options->SetGridConstraints(0, 0, 1, 1, 0x1E);
  _pMainFrame = options->GetOptionsFrame();
  if (!_pMainFrame) return 0;

  ZEPSettingInfo info;
  int rows = 0;

  auto* frmStd = new ZEPDlgFrame(_pMainFrame, "frmStd", 0x80001);
  frmStd->SetGridConstraints(0, 0, 1, 1, 0x1E);
  rows = 1;
  (new ZEPDrwLockLabel(frmStd, "lblStd", 1))->SetGridConstraints(0, 0, 1, 1, 0x1E);
  GetSysStandardNameInfo(info);
  _cmbStandardName = new ZEPDrwLockCombo(frmStd, "cmbStandardName", info, 0x1040000);
  _cmbStandardName->SetGridConstraints(0, 1, 1, 1, 0x1E);
  _cmbStandardName->SetVisibleTextWidth(15);
  if (ZEPDlgCombo* pCmb = _cmbStandardName->GetCombo()) {
    AddAnalyseNotificationCB(pCmb, pCmb->GetComboSelectNotification(), &ZEP2DBaseOptMainFrm::Write,
                             nullptr);
    AddAnalyseNotificationCB(pCmb, pCmb->GetComboDropNotification(),
                             &ZEP2DBaseOptMainFrm::ComboNotif, nullptr);
    AddAnalyseNotificationCB(pCmb, pCmb->GetComboCloseUpNotification(),
                             &ZEP2DBaseOptMainFrm::ComboNotif, nullptr);
  }
  auto pushButton = [this, frmStd, &info](const char* iName, short iColumn, const char* iIcon) {
    auto* push = new ZEPDrwLockPushButton(frmStd, iName, info);
    push->SetGridConstraints(0, iColumn, 1, 1, 0x1E);
    push->SetIconName(iIcon, "", "", "");
    AddAnalyseNotificationCB(push->GetDialog(), push->GetPushBActivateNotification(),
                             &ZEP2DBaseOptMainFrm::NotifPush, nullptr);
    return push;
  };
  if (GetSysStandardPLMAddInfo(info) >= 0)
    _pPushStandardPLMAdd = pushButton("pusStandardPLMAdd", 2, "I_D3M_Add");
  if (GetSysStandardPLMRemoveInfo(info) >= 0)
    _pPushStandardPLMRemove = pushButton("pusStandardPLMRemove", 3, "I_D3M_Remove");

  if (GetSysInsertDrawingInfo(info) >= 0) {
    _pChkInsertDrawing = new ZEPDrwLockCheckButton(_pMainFrame, "chkInsertDrawing", info, 0);
    _pChkInsertDrawing->SetGridConstraints(static_cast<short>(rows++), 0, 1, 1, 0x1E);
    AddAnalyseNotificationCB(_pChkInsertDrawing->GetDialog(),
                             _pChkInsertDrawing->GetChkBModifyNotification(),
                             &ZEP2DBaseOptMainFrm::Write, nullptr);
  }

  if (GetSysMakeDrawingShareableInfo(info) >= 0) {
    auto* frame = new ZEPDlgFrame(_pMainFrame, "frmMakeDrawingShareable", 0x80001);
    frame->SetGridConstraints(static_cast<short>(rows++), 0, 1, 1, 0x1E);
    (new ZEPDrwLockLabel(frame, "lblInv", 0))->SetGridConstraints(0, 0, 1, 1, 0x1E);
    _pChkMakeDrawingShareable =
        new ZEPDrwLockCheckButton(frame, "chkMakeDrawingShareable", info, 0);
    _pChkMakeDrawingShareable->SetGridConstraints(0, 1, 1, 1, 0x1E);
    AddAnalyseNotificationCB(_pChkMakeDrawingShareable->GetDialog(),
                             _pChkMakeDrawingShareable->GetChkBModifyNotification(),
                             &ZEP2DBaseOptMainFrm::Write, nullptr);
  }

  if (GetSysScaleRatioInfo(info) >= 0) {
    auto* frame = new ZEPDlgFrame(_pMainFrame, "frmScaleRatio", 0x80001);
    frame->SetGridConstraints(static_cast<short>(rows++), 0, 1, 1, 0x1E);
    auto* label = new ZEPDrwLockLabel(frame, "lblScaleRatio", 1);
    label->SetGridConstraints(0, 0, 1, 1, 0x1E);
    // One padlock for the ratio editors and the range combo: a locked ratio also keeps the
    // range shown.
    auto* locked = new ZEPDrwLockFrame(frame, "ScaleRatioFrm", info, 0x80001);
    locked->SetGridConstraints(0, 1, 1, 1, 0x1E);
    if (ZEPDialog* inner = locked->GetDialog()) {
      _pEdtScaleRatio = new ZEPDlgEditor(inner, "edtScaleRatio", 0);
      _pEdtScaleRatio->SetGridConstraints(0, 0, 1, 1, 0x1E);
      _pEdtScaleRatio->SetVisibleTextWidth(6);
      _pEdtScaleRatio->SetLongHelp(label->GetLongHelp());
      AddAnalyseNotificationCB(_pEdtScaleRatio, _pEdtScaleRatio->GetEditModifyNotification(),
                               &ZEP2DBaseOptMainFrm::Write, nullptr);
      (new ZEPDlgLabel(inner, "lblRatioEq", 0))->SetGridConstraints(0, 1, 1, 1, 0x1E);
      // Shows the decimal value only.
      _pEdtScaleRatioDec = new ZEPDlgEditor(inner, "edtScaleRatioDec", 0x4020000);
      _pEdtScaleRatioDec->SetGridConstraints(0, 2, 1, 1, 0x1E);
      _pEdtScaleRatioDec->SetVisibleTextWidth(6);
      _pEdtScaleRatioDec->SetLongHelp(label->GetLongHelp());
      _pEdtScaleRatioDec->SetSensitivity(ZEPDlgDisable);
      _pCmbRatioRange = new ZEP2DBaseRangeCmb(inner, "cmbRatioRange");
      _pCmbRatioRange->SetGridConstraints(0, 3, 1, 1, 0x7E);
      AddAnalyseNotificationCB(_pCmbRatioRange, _pCmbRatioRange->GetComboSelectNotification(),
                               &ZEP2DBaseOptMainFrm::Write, nullptr);
    }
  }
  return rows;
}

// ---- showing the values ------------------------------------------------------------------------
void ZEP2DBaseOptMainFrm::Initialize() {
  GetSysStandardName(_standardName);
  GetSysStandardPLMList(_lstStdPLMNames);
  GetSysStandardPLMIDList(_lstStdPLMIDs);
  // Names and keys go in pairs: lists that do not pair up are dropped.
  if (_lstStdPLMNames.Size() != _lstStdPLMIDs.Size()) {
    _lstStdPLMNames.RemoveAll(1);
    _lstStdPLMIDs.RemoveAll(1);
  }
  GetSysInsertDrawing(_bInsertDrawing);
  GetSysMakeDrawingShareable(_bMakeDrawingShareable);
  GetSysScaleRatio(_dScaleRatio, kRangeCount);
  // Without a scales service the combo answers -1: the page keeps the range it shows.
  if (_pCmbRatioRange) {
    const int range = _pCmbRatioRange->GetSelect();
    if (range >= 1 && range <= kRangeCount) _currentRange = range;
  }
  UpdateWidgets();
}

void ZEP2DBaseOptMainFrm::UpdateWidgets() {
  UpdateComboStd(false);
  Services::UpdateCheckButton(_pChkInsertDrawing, _bInsertDrawing);
  Services::UpdateCheckButton(_pChkMakeDrawingShareable, _bMakeDrawingShareable);
  UpdateShareableSensitivity();
  UpdateScaleRatioEditors();
}

void ZEP2DBaseOptMainFrm::UpdateShareableSensitivity() {
  if (_pChkMakeDrawingShareable)
    _pChkMakeDrawingShareable->SetSensitivity(Sensitivity(_bInsertDrawing != 0));
}

// Folder lines first, then one line per PLM standard; the current standard is selected, or
// shown as an extra line 0 when it is in neither list.
void ZEP2DBaseOptMainFrm::UpdateComboStd(bool iDropping) {
  if (!_cmbStandardName)
    return Check_Pointer_Failed__("_cmbStandardName", kPath, __LINE__, nullptr);
  ZEPDlgCombo* pCmb = _cmbStandardName->GetCombo();
  if (!pCmb) return Check_Pointer_Failed__("pCmb", kPath, __LINE__, nullptr);

  _cmbStandardName->ClearLine();
  const ZEPString folderIcon = _pPushStandardPLMAdd ? kFolderIcon : "";
  for (const ZEPUnicodeString& name : _lstStdFolder.Items())
    _cmbStandardName->SetLine(name, folderIcon);
  if (_lstStdPLMNames.Size() != _lstStdPLMIDs.Size()) {
    CheckFailure__("", kPath, __LINE__, nullptr);
    _lstStdPLMNames.RemoveAll(1);
    _lstStdPLMIDs.RemoveAll(1);
  } else {
    for (const ZEPUnicodeString& name : _lstStdPLMNames.Items())
      _cmbStandardName->SetLine(name, kDatabaseIcon);
  }

  const unsigned char databaseStd = ReadFlag(this, &ZEP2DBaseOptMainFrm::GetSysIsStandardPLM);
  const int idxInFolder = _lstStdFolder.Locate(_standardName, 1);
  const int idxInDatabase = _lstStdPLMIDs.Locate(_standardName, 1);
  if (idxInFolder == 0 && idxInDatabase == 0) {
    if (!iDropping) {
      const ZEPString icon =
          !_pPushStandardPLMAdd ? "" : (databaseStd ? kDatabaseIcon : kFolderIcon);
      const int first = 0;
      if (icon.empty())
        pCmb->SetLine(_standardName, first, 0x40u);
      else
        pCmb->SetLine(_standardName, icon, first, 0x40u);
    } else {
      pCmb->ClearSelect();
    }
  } else {
    if (!((!databaseStd && 0 < idxInFolder) || (databaseStd && 0 < idxInDatabase)))
      Check_TRUE_Failed__("(!databaseStd && 0<idxInFolder) || (databaseStd && 0<idxInDatabase)",
                          kPath, __LINE__, nullptr);
    if (!databaseStd && idxInFolder > 0)
      pCmb->SetSelect(idxInFolder - 1, 0);
    else if (databaseStd && idxInDatabase > 0)
      pCmb->SetSelect(_lstStdFolder.Size() + idxInDatabase - 1, 0);
    else
      _cmbStandardName->SetSelect(ZEPUnicodeString(), 0);
  }
  if (_pPushStandardPLMRemove)
    _pPushStandardPLMRemove->SetSensitivity(Sensitivity(idxInDatabase > 0));
}

void ZEP2DBaseOptMainFrm::UpdateScaleRatioEditors() {
  if (!_pEdtScaleRatio || !_pEdtScaleRatioDec) return;
  const double ratio = _dScaleRatio[Index()];
  double numerator = 1.0, denominator = 1.0;
  if (FAILED(
          ZEPDfuScaleAndUnitsToolbox::DecimalToFractionConvertor(ratio, numerator, denominator, 6)))
    return;
  char text[64];
  std::snprintf(text, sizeof text, "%g:%g", numerator, denominator);
  _pEdtScaleRatio->SetText(ZEPUnicodeString(text), 0);
  _pEdtScaleRatioDec->SetValue(ratio, 0);
}

void ZEP2DBaseOptMainFrm::ComboNotif(ZEPCommand*, ZEPNotification* iNotif, void*) {
  if (!_cmbStandardName)
    return Check_Pointer_Failed__("_cmbStandardName", kPath, __LINE__, nullptr);
  auto* pDropNotif = ZEPSysDynamicCast<ZEPDlgComboDropNotification>(iNotif);
  auto* pCloseUpNotif = ZEPSysDynamicCast<ZEPDlgComboCloseUpNotification>(iNotif);
  if (!pDropNotif && !pCloseUpNotif)
    return Check_TRUE_Failed__("pDropNotif || pCloseUpNotif", kPath, __LINE__, nullptr);
  UpdateComboStd(pDropNotif != nullptr);
}

// ---- user changes ------------------------------------------------------------------------------
void ZEP2DBaseOptMainFrm::Write(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (!iSender) return;
  if (_cmbStandardName && iSender == _cmbStandardName->GetDialog()) return WriteStandard();
  if (Services::GetValueFromCheckButton(_pChkInsertDrawing, iSender, _bInsertDrawing) == S_OK) {
    SetSysInsertDrawing(_bInsertDrawing);
    UpdateShareableSensitivity();
    return;
  }
  if (Services::GetValueFromCheckButton(_pChkMakeDrawingShareable, iSender,
                                        _bMakeDrawingShareable) == S_OK) {
    SetSysMakeDrawingShareable(_bMakeDrawingShareable);
    return;
  }
  if (_pEdtScaleRatio && ZEPSysDynamicCast<ZEPDlgEditor>(iSender) == _pEdtScaleRatio)
    return WriteScaleRatio();
  if (_pCmbRatioRange && iSender == _pCmbRatioRange) {
    const int range = _pCmbRatioRange->GetSelect();
    if (range >= 1 && range <= kRangeCount) _currentRange = range;
    UpdateScaleRatioEditors();
  }
}

void ZEP2DBaseOptMainFrm::WriteStandard() {
  const unsigned char previousPLM = ReadFlag(this, &ZEP2DBaseOptMainFrm::GetSysIsStandardPLM);
  ZEPDlgCombo* pCmb = _cmbStandardName->GetCombo();
  if (!pCmb) return Check_Pointer_Failed__("pCmb", kPath, __LINE__, nullptr);
  const int selected = pCmb->GetSelect();
  if (selected < 0) return; // nothing picked: nothing to write
  ZEPUnicodeString text;
  ZEPString icon;
  pCmb->GetLine(text, selected);
  pCmb->GetLineIconName(icon, selected);
  const bool isPLM = icon == kDatabaseIcon;

  ZEPUnicodeString name = text;
  if (isPLM) {
    // The PLM lines are the combo's last lines, in list order: the line's position tells which
    // standard it is, also when two share a display name. The search by name only serves
    // a line that is not where the lists put it.
    const int position = selected - (pCmb->GetLineCount() - _lstStdPLMNames.Size()) + 1;
    int idx = 0;
    if (position >= 1 && position <= _lstStdPLMNames.Size() && _lstStdPLMNames[position] == text)
      idx = position;
    else
      idx = _lstStdPLMNames.Locate(text, 1);
    if (!idx) return Check_TRUE_Failed__("idx", kPath, __LINE__, nullptr);
    if (!(0 < idx && idx <= _lstStdPLMIDs.Size()))
      return Check_TRUE_Failed__("0<idx&&idx<=_lstStdPLMIDs.Size()", kPath, __LINE__, nullptr);
    name = _lstStdPLMIDs[idx];
  }

  const bool changed = name != _standardName || isPLM != (previousPLM != 0);
  _standardName = name;
  if (!changed) return;
  const unsigned char flag = isPLM ? 1 : 0;
  SetSysStandardName(_standardName);
  SetSysIsStandardPLM(flag);
  UpdateComboStd(false);
}

void ZEP2DBaseOptMainFrm::WriteScaleRatio() {
  ZEPUnicodeString normal;
  double value = 1.0;
  int form = 0;
  const long rc = ZEPDfuScaleAndUnitsToolbox::ConvertScaleFromStringToDouble(
      _pEdtScaleRatio->GetText(), normal, value, form);
  const ZEPDibTolerances tolerances(ZEP2DBaseRangeCmb::GetMatchingRange(_currentRange));
  const double largest = tolerances.GetTolerance(7);
  const double smallest = tolerances.GetTolerance(6);
  // A tolerance that is not a positive number gives no bound at all: nothing is accepted.
  const bool bounded =
      std::isfinite(largest) && std::isfinite(smallest) && largest > 0.0 && smallest > 0.0;
  if (SUCCEEDED(rc) && bounded && 1.0 / largest <= value && value <= 1.0 / smallest) {
    _dScaleRatio[Index()] = value;
    SetSysScaleRatio(_dScaleRatio, kRangeCount);
  }
  // A refused entry gives way to the stored ratio.
  UpdateScaleRatioEditors();
}

// ---- PLM standards ------------------------------------------------------------------------------
void ZEP2DBaseOptMainFrm::NotifPush(ZEPCommand* iSender, ZEPNotification*, void*) {
  if (!iSender) return;
  if (_pPushStandardPLMAdd && iSender == _pPushStandardPLMAdd->GetDialog()) return OpenPLMChooser();
  if (_pPushStandardPLMRemove && iSender == _pPushStandardPLMRemove->GetDialog())
    return RemovePLMStandard();
}

void ZEP2DBaseOptMainFrm::OpenPLMChooser() {
  // One chooser at a time: its choice must reach the page, and it is the one to close.
  if (_pPLMObjectChooser) return _pPLMObjectChooser->SetVisibility(ZEPDlgShow);

  ZEPIPLMChooserFactory* pChooserFactory = nullptr;
  ZEPPLMUIBasicServices::GetPLMChooserFactory(pChooserFactory);
  if (!pChooserFactory) return Check_Pointer_Failed__("pChooserFactory", kPath, __LINE__, nullptr);
  pChooserFactory->CreatePLMChooser(this, "ZEPDbsSettingPLMStandardChooser", _pPLMObjectChooser);
  pChooserFactory->Release();
  if (!_pPLMObjectChooser)
    return Check_Pointer_Failed__("_pPLMObjectChooser", kPath, __LINE__, nullptr);

  ZEPIType_var spType;
  ZEPCkeTypeProtectedServices::RetrieveKnowledgeType("DIFStandardRep", spType);
  ZEPListValZEPIType_var types;
  types.Append(spType);
  _pPLMObjectChooser->SetTypes(types);
  ZEPPLMNavigationOpenParameters parameters;
  parameters.SetModeValue(0x2000000);
  _pPLMObjectChooser->SetNavigationOpenParameters(parameters, 18);
  ZEPRawCollint modes;
  modes.Append(0);
  modes.Append(1);
  _pPLMObjectChooser->SetModes(modes, 0);

  ZEPCommand* pPLMChooserCommand = _pPLMObjectChooser->GetCommand();
  if (!pPLMChooserCommand) {
    // A chooser nobody can validate or cancel would never be shown nor released.
    Check_Pointer_Failed__("pPLMChooserCommand", kPath, __LINE__, nullptr);
    return ReleasePLMChooser();
  }
  pPLMChooserCommand->SetFather(this);
  AddAnalyseNotificationCB(pPLMChooserCommand, _pPLMObjectChooser->GetValidateNotification(),
                           &ZEP2DBaseOptMainFrm::ClosePLMChooser, nullptr);
  AddAnalyseNotificationCB(pPLMChooserCommand, _pPLMObjectChooser->GetCancelNotification(),
                           &ZEP2DBaseOptMainFrm::ClosePLMChooser, nullptr);
  _pPLMObjectChooser->SetVisibility(ZEPDlgShow);
}

void ZEP2DBaseOptMainFrm::ReleasePLMChooser() {
  if (!_pPLMObjectChooser) return;
  _pPLMObjectChooser->Release();
  _pPLMObjectChooser = nullptr;
}

void ZEP2DBaseOptMainFrm::ClosePLMChooser(ZEPCommand*, ZEPNotification* iNotif, void*) {
  if (!iNotif) return Check_Pointer_Failed__("iNotif", kPath, __LINE__, nullptr);
  if (!_pPLMObjectChooser)
    return Check_Pointer_Failed__("_pPLMObjectChooser", kPath, __LINE__, nullptr);

  ZEPNotification* pNotif = _pPLMObjectChooser->GetValidateNotification();
  if (iNotif->IsEqual(pNotif)) {
    ZEPListPtrZEPBaseUnknown* pList = nullptr;
    _pPLMObjectChooser->GetChosenObjects(pList);
    int added = 0;
    for (int i = 1; pList && i <= pList->Size(); ++i) {
      ZEPRefCounted* pObject = (*pList)[i];
      ZEPIPLMComponent* pComponent = nullptr;
      if (pObject) {
        pObject->QueryInterface(pComponent);
        pObject->Release();
      }
      if (!pComponent) {
        CheckFailure__("", kPath, __LINE__, nullptr);
        continue;
      }
      ZEPIAlias* pAlias = nullptr;
      pComponent->QueryInterface(pAlias);
      if (!pAlias) {
        CheckFailure__("", kPath, __LINE__, nullptr);
        pComponent->Release();
        continue;
      }
      ZEPPLMIdentificator* pID = nullptr;
      pComponent->GetPLMID(pID);
      ZEPAdpComponentQuery query(nullptr);
      ZEPAdpUniqueKey key;
      const long rc = query.GetUniqueKey(pID, key, nullptr);
      if (pID) pID->Release();
      if (FAILED(rc) || key.UnicityGuarantee() < 0) {
        CheckFailure__("", kPath, __LINE__, nullptr);
        pAlias->Release();
        pComponent->Release();
        continue;
      }
      const ZEPUnicodeString keyString = key.AsString();
      if (_lstStdPLMIDs.Locate(keyString, 1) == 0) {
        _lstStdPLMNames.Append(pAlias->GetAlias());
        _lstStdPLMIDs.Append(keyString);
        if (added++ == 0) _standardName = keyString;
      }
      pAlias->Release();
      pComponent->Release();
    }
    delete pList;
    if (added > 0) {
      const unsigned char on = 1;
      SetSysStandardPLMList(_lstStdPLMNames);
      SetSysStandardPLMIDList(_lstStdPLMIDs);
      SetSysStandardName(_standardName);
      SetSysIsStandardPLM(on);
      UpdateComboStd(false);
    }
  } else {
    pNotif = _pPLMObjectChooser->GetCancelNotification();
    if (!iNotif->IsEqual(pNotif))
      Check_TRUE_Failed__("iNotif->IsEqual(pNotif)", kPath, __LINE__, nullptr);
  }
  _pPLMObjectChooser->SetVisibility(ZEPDlgHide);
  ReleasePLMChooser();
}

void ZEP2DBaseOptMainFrm::RemovePLMStandard() {
  const int idx = _lstStdPLMIDs.Locate(_standardName, 1);
  if (!(idx > 0)) return Check_TRUE_Failed__("idx>0", kPath, __LINE__, nullptr);
  _lstStdPLMNames.RemovePosition(idx);
  _lstStdPLMIDs.RemovePosition(idx);
  SetSysStandardPLMList(_lstStdPLMNames);
  SetSysStandardPLMIDList(_lstStdPLMIDs);
  _standardName = GetDefaultStandardName();
  if (_lstStdFolder.Locate(_standardName, 1) > 0) {
    const unsigned char off = 0;
    SetSysStandardName(_standardName);
    SetSysIsStandardPLM(off);
  }
  UpdateComboStd(false);
}
