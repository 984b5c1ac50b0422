#include "ZEPDrwLockPushButton.h"

namespace {
const char* const kPath = "DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEPDrwLockPushButton";
}

ZEPDrwLockPushButton::ZEPDrwLockPushButton(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo)
    : ZEPDrwLockDialog(iParent, iName, iInfo) {
  _pDialog = new ZEPDlgPushButton(this, iName + "_dialog", 0);
  Initialize();
}

ZEPNotification* ZEPDrwLockPushButton::GetPushBActivateNotification() {
  ZEPDlgPushButton* pPush = ZEPSysDynamicCast<ZEPDlgPushButton>(_pDialog);
  if (!pPush) {
    Check_Pointer_Failed__("pPush", kPath, __LINE__, nullptr);
    return nullptr;
  }
  return pPush->GetPushBActivateNotification();
}
