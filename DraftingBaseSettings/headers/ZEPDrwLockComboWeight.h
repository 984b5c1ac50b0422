#pragma once

#include "ZEPDrwLockControl.h"

class ZEPDrwLockComboWeight : public ZEPDrwLockControl {
public:
  ZEPDrwLockComboWeight(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                        unsigned long iStyle, unsigned int iValue);
  ZEPComboWeight* GetCombo() const;
  // 1 without a combo.
  unsigned int GetSelect() const;
  void SetSelect(unsigned int iWeight);
  void SetVisibleTextHeight(int iHeight);
  void SetVisibleTextWidth(int iWidth);
};
