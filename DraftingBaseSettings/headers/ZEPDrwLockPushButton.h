#pragma once

#include "ZEPDrwLockDialog.h"

class ZEPDrwLockPushButton : public ZEPDrwLockDialog {
public:
  ZEPDrwLockPushButton(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo);
  // Null (reported) when the inner control is not a push button.
  ZEPNotification* GetPushBActivateNotification();
};
