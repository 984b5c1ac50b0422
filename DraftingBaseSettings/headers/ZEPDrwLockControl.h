// Lock-aware control whose inner control may be a toolkit value control (unit handling).
#pragma once

#include "ZEPDrwLockDialog.h"

class ZEPDrwLockControl : public ZEPDrwLockDialog {
public:
  ZEPDrwLockControl(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo);

  void SetMagnitude(ZEPDlgMagnitude iMagnitude);
  void SetUnit(ZEPDlgUnit iUnit);
  void SetPrecision(int iPrecision);
  // Fallbacks without a value control inside: magnitude 11, unit 45, precision 1.
  ZEPDlgMagnitude GetMagnitude() const;
  ZEPDlgUnit GetUnit() const;
  int GetPrecision() const;

private:
  ZEPDlgControl* ValueControl() const;
};
