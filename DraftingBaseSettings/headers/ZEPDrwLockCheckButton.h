#pragma once

#include "ZEPDrwLockControl.h"

class ZEPDrwLockCheckButton : public ZEPDrwLockControl {
public:
  ZEPDrwLockCheckButton(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                        unsigned long iStyle = 0);
  ZEPNotification* GetChkBModifyNotification();
  ZEPNotification* GetChkBDoubleClickNotification();
  // Unchecked (0x80000) without an inner control.
  unsigned long GetState() const;
  void SetState(unsigned long iState, int iNotify = 1);

private:
  ZEPDlgCheckButton* Button() const;
};
