#include "ZEPDrwLockLabel.h"

ZEPDrwLockLabel::ZEPDrwLockLabel(ZEPDialog* iParent, const ZEPString& iName, int iWithText)
    : ZEPDlgFrame(iParent, iName, 0x80001) {
  _pPlaceholder = new ZEPDlgCheckButton(this, iName, 0);
  if (iWithText != 0) _pLabel = new ZEPDlgLabel(this, iName, 0);
  if (_pLabel) _pLabel->SetTitle(ZEPDlgFrame::GetTitle());
  ZEPDlgFrame::SetShortHelp(ZEPUnicodeString());
  ZEPDlgFrame::SetHelp(ZEPUnicodeString());
  if (_pLabel) _pLabel->SetLongHelp(ZEPDlgFrame::GetLongHelp());
  // An invisible padlock-sized cell keeps the caption in line with lock-aware controls.
  _pPlaceholder->SetIconName("CheckLock", "", "", "", 0);
  _pPlaceholder->SetVisibility(ZEPDlgHide);
  _pPlaceholder->SetGridConstraints(0, 0, 1, 1, 0x1E);
  if (_pLabel) _pLabel->SetGridConstraints(0, 1, 1, 1, 0x58);
}

ZEPDrwLockLabel::~ZEPDrwLockLabel() {
  _pPlaceholder = nullptr;
  _pLabel = nullptr;
}

ZEPString ZEPDrwLockLabel::GetName() const { return _pLabel ? _pLabel->GetName() : ZEPDlgFrame::GetName(); }

void ZEPDrwLockLabel::SetTitle(const ZEPUnicodeString& iText) {
  if (_pLabel) _pLabel->SetTitle(iText);
}
void ZEPDrwLockLabel::SetHelp(const ZEPUnicodeString& iText) {
  if (_pLabel) _pLabel->SetHelp(iText);
}
void ZEPDrwLockLabel::SetShortHelp(const ZEPUnicodeString& iText) {
  if (_pLabel) _pLabel->SetShortHelp(iText);
}
void ZEPDrwLockLabel::SetLongHelp(const ZEPUnicodeString& iText) {
  if (_pLabel) _pLabel->SetLongHelp(iText);
}
void ZEPDrwLockLabel::SetIconName(const ZEPString& iNormal, const ZEPString& iSelected, const ZEPString& iFocused,
                                  const ZEPString& iDisabled) {
  if (_pLabel) _pLabel->SetIconName(iNormal, iSelected, iFocused, iDisabled, 0);
}

const ZEPUnicodeString& ZEPDrwLockLabel::GetTitle() const {
  return _pLabel ? _pLabel->GetTitle() : ZEPDlgFrame::GetTitle();
}
const ZEPUnicodeString& ZEPDrwLockLabel::GetHelp() const {
  return _pLabel ? _pLabel->GetHelp() : ZEPDlgFrame::GetHelp();
}
const ZEPUnicodeString& ZEPDrwLockLabel::GetShortHelp() const {
  return _pLabel ? _pLabel->GetShortHelp() : ZEPDlgFrame::GetShortHelp();
}
const ZEPUnicodeString& ZEPDrwLockLabel::GetLongHelp() const {
  return _pLabel ? _pLabel->GetLongHelp() : ZEPDlgFrame::GetLongHelp();
}
