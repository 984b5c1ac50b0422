#pragma once

#include "ZEPDrwLockControl.h"

class ZEPDrwLockEditor : public ZEPDrwLockControl {
public:
  ZEPDrwLockEditor(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                   unsigned long iStyle = 0);
  ZEPDlgEditor* GetEditor() const;
};
