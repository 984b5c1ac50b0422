// A padlock guarding a whole group: the guarded controls go inside GetDialog().
#pragma once

#include "ZEPDrwLockDialog.h"

class ZEPDrwLockFrame : public ZEPDrwLockDialog {
public:
  // The inner frame is named N + "locked".
  ZEPDrwLockFrame(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo, unsigned long iStyle);
};
