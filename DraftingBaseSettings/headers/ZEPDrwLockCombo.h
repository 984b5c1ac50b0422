#pragma once

#include "ZEPDrwLockControl.h"

class ZEPDrwLockCombo : public ZEPDrwLockControl {
public:
  ZEPDrwLockCombo(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                  unsigned long iStyle = 0x40000);
  // The inner control as a combo; null (reported) when it is not one.
  ZEPDlgCombo* GetCombo() const;
  void ClearLine();
  void SetVisibleTextWidth(int iWidth);
  // Appends a line, with an icon when iIconName is not empty; -1 without a combo.
  int SetLine(const ZEPUnicodeString& iText, const ZEPString& iIconName = "");
  int SetSelect(const ZEPUnicodeString& iText, int iNotify = 1);
};
