#include "ZEPDrwLockDialog.h"

ZEPDrwLockDialog::ZEPDrwLockDialog(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo)
    : ZEPDlgFrame(iParent, iName, 0x80001) {
  _pLock = new ZEPDlgLock(this, iName + "Lock", iInfo, 0);
}

ZEPDrwLockDialog::~ZEPDrwLockDialog() {
  // Both widgets are children: the toolkit destroys them with this frame.
  _pDialog = nullptr;
  _pLock = nullptr;
}

void ZEPDrwLockDialog::Initialize() {
  if (!_pDialog || !_pLock) return;
  _pLock->AddAssociatedDialog(_pDialog);
  _pLock->SetGridConstraints(0, 0, 1, 1, 0x1E);
  _pDialog->SetGridConstraints(0, 1, 1, 1, 0x58);
  // The frame was given the catalog texts of its name; the inner control shows them.
  _pDialog->SetTitle(ZEPDlgFrame::GetTitle());
  _pLock->SetLongHelp(ZEPDlgFrame::GetLongHelp());
  _pDialog->SetLongHelp(ZEPDlgFrame::GetLongHelp());
}

ZEPDialog* ZEPDrwLockDialog::GetDialog() const { return _pDialog; }

ZEPString ZEPDrwLockDialog::GetName() const { return _pDialog ? _pDialog->GetName() : ZEPDlgFrame::GetName(); }

void ZEPDrwLockDialog::SetSensitivity(unsigned long iSensitivity) {
  if (!_pLock || !_pDialog) return;
  unsigned long imposed = 0;
  _pLock->GetAssociatedDialogSensitivity(imposed);
  if (imposed == ZEPDlgDisable) return;
  _pDialog->SetSensitivity(iSensitivity);
}

unsigned long ZEPDrwLockDialog::GetSensitivity() const {
  if (!_pLock || !_pDialog) return ZEPDlgDisable;
  unsigned long imposed = ZEPDlgDisable;
  _pLock->GetAssociatedDialogSensitivity(imposed);
  return imposed == ZEPDlgDisable ? ZEPDlgDisable : _pDialog->GetSensitivity();
}

void ZEPDrwLockDialog::SetTitle(const ZEPUnicodeString& iText) {
  if (_pDialog) _pDialog->SetTitle(iText);
}

void ZEPDrwLockDialog::SetHelp(const ZEPUnicodeString& iText) {
  if (_pLock) _pLock->SetHelp(iText);
  if (_pDialog) _pDialog->SetHelp(iText);
}

void ZEPDrwLockDialog::SetShortHelp(const ZEPUnicodeString& iText) {
  if (_pLock) _pLock->SetShortHelp(iText);
  if (_pDialog) _pDialog->SetShortHelp(iText);
}

void ZEPDrwLockDialog::SetLongHelp(const ZEPUnicodeString& iText) {
  if (_pLock) _pLock->SetLongHelp(iText);
  if (_pDialog) _pDialog->SetLongHelp(iText);
}

const ZEPUnicodeString& ZEPDrwLockDialog::GetTitle() const {
  return _pDialog ? _pDialog->GetTitle() : ZEPDlgFrame::GetTitle();
}
const ZEPUnicodeString& ZEPDrwLockDialog::GetHelp() const {
  return _pDialog ? _pDialog->GetHelp() : ZEPDlgFrame::GetHelp();
}
const ZEPUnicodeString& ZEPDrwLockDialog::GetShortHelp() const {
  return _pDialog ? _pDialog->GetShortHelp() : ZEPDlgFrame::GetShortHelp();
}
const ZEPUnicodeString& ZEPDrwLockDialog::GetLongHelp() const {
  return _pDialog ? _pDialog->GetLongHelp() : ZEPDlgFrame::GetLongHelp();
}

void ZEPDrwLockDialog::SetIconName(const ZEPString& iNormal, const ZEPString& iSelected, const ZEPString& iFocused,
                                   const ZEPString& iDisabled) {
  if (_pDialog) _pDialog->SetIconName(iNormal, iSelected, iFocused, iDisabled, 0);
}
