#pragma once

#include "ZEPDrwLockControl.h"

class ZEPDrwLockComboColor : public ZEPDrwLockControl {
public:
  ZEPDrwLockComboColor(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo);
  ZEPComboColor* GetCombo() const;
  int GetSelectedColor(unsigned int* oRed, unsigned int* oGreen, unsigned int* oBlue) const;
  // Fills the outputs when there is a colour; always answers 0.
  int GetSelectedColor(unsigned int* oRed, unsigned int* oGreen, unsigned int* oBlue, ZEPUnicodeString* oName) const;
  void SetSelectedColor(unsigned int iRed, unsigned int iGreen, unsigned int iBlue);
  void SetVisibleTextWidth(int iWidth);
};
