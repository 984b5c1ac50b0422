#include "ZEPDrwLockIconBox.h"

namespace {
const char* const kPath = "DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEPDrwLockIconBox";
}

ZEPDrwLockIconBox::ZEPDrwLockIconBox(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                                     unsigned long iStyle)
    : ZEPDrwLockDialog(iParent, iName, iInfo) {
  _pDialog = new ZEPDlgIconBox(this, iName + "_dialog", iStyle);
  Initialize();
}

ZEPDlgIconBox* ZEPDrwLockIconBox::Box() const {
  ZEPDlgIconBox* pIcb = ZEPSysDynamicCast<ZEPDlgIconBox>(_pDialog);
  if (!pIcb) Check_Pointer_Failed__("pIcb", kPath, __LINE__, nullptr);
  return pIcb;
}

ZEPNotification* ZEPDrwLockIconBox::GetIBoxSelectNotification() {
  ZEPDlgIconBox* b = Box();
  return b ? b->GetIBoxSelectNotification() : nullptr;
}

int ZEPDrwLockIconBox::GetSelect() {
  ZEPDlgIconBox* b = Box();
  return b ? b->GetSelect() : -1;
}

int ZEPDrwLockIconBox::SetSelect(const ZEPString& iIconName, int iNotify) {
  ZEPDlgIconBox* b = Box();
  return b ? b->SetSelect(iIconName, iNotify) : -1;
}

int ZEPDrwLockIconBox::SetSelect(int iIndex, int iNotify) {
  ZEPDlgIconBox* b = Box();
  return b ? b->SetSelect(iIndex, iNotify) : -1;
}
