#include "ZEPDrwLockCheckButton.h"

ZEPDrwLockCheckButton::ZEPDrwLockCheckButton(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                                             unsigned long iStyle)
    : ZEPDrwLockControl(iParent, iName, iInfo) {
  _pDialog = new ZEPDlgCheckButton(this, iName + "_dialog", iStyle);
  Initialize();
}

ZEPDlgCheckButton* ZEPDrwLockCheckButton::Button() const { return ZEPSysDynamicCast<ZEPDlgCheckButton>(_pDialog); }

ZEPNotification* ZEPDrwLockCheckButton::GetChkBModifyNotification() {
  ZEPDlgCheckButton* b = Button();
  return b ? b->GetChkBModifyNotification() : nullptr;
}

ZEPNotification* ZEPDrwLockCheckButton::GetChkBDoubleClickNotification() {
  ZEPDlgCheckButton* b = Button();
  return b ? b->GetChkBDoubleClickNotification() : nullptr;
}

unsigned long ZEPDrwLockCheckButton::GetState() const {
  ZEPDlgCheckButton* b = Button();
  return b ? b->GetState() : ZEPDlgUnchecked;
}

void ZEPDrwLockCheckButton::SetState(unsigned long iState, int iNotify) {
  if (ZEPDlgCheckButton* b = Button()) b->SetState(iState, iNotify);
}
