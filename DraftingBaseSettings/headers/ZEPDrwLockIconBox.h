#pragma once

#include "ZEPDrwLockDialog.h"

class ZEPDrwLockIconBox : public ZEPDrwLockDialog {
public:
  ZEPDrwLockIconBox(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                    unsigned long iStyle = 0);
  ZEPNotification* GetIBoxSelectNotification();
  // -1 without an icon box.
  virtual int GetSelect();
  virtual int SetSelect(const ZEPString& iIconName, int iNotify);
  virtual int SetSelect(int iIndex, int iNotify);

private:
  ZEPDlgIconBox* Box() const;
};
