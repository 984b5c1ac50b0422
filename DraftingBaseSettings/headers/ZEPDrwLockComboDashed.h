// Line-type combo. The settings code the break line as 0; the combo lists it as entry 8.
#pragma once

#include "ZEPDrwLockControl.h"

class ZEPDrwLockComboDashed : public ZEPDrwLockControl {
public:
  ZEPDrwLockComboDashed(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                        char iWithBreakLine, unsigned long iStyle, unsigned int iValue);
  ZEPComboDashed* GetCombo() const;
  // The selected line type; entry 8 answers 0, and so does no selection.
  unsigned int GetSelect() const;
  // 0 selects entry 8.
  void SetSelect(unsigned int iType);
  void SetVisibleTextHeight(int iHeight);
  void SetVisibleTextWidth(int iWidth);
};
