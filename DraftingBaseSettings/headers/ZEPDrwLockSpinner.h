#pragma once

#include "ZEPDrwLockControl.h"

class ZEPDrwLockSpinner : public ZEPDrwLockControl {
public:
  // Pages pass 0x60000 for lengths and angles, 0x40000 for counts.
  ZEPDrwLockSpinner(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                    unsigned long iStyle = 0x40000);
  ZEPDlgSpinner* GetSpinner() const;
  double GetValue() const;
  void SetValue(double iValue, int iNotify = 1);
  float GetCurrentValue() const;
  float SetCurrentValue(float iValue, int iNotify = 1);
  const char* GetFormat() const;
  void SetFormat(const char* iFormat);
  void GetMinMaxStep(double& oMin, double& oMax, double& oStep) const;
  void SetMinMaxStep(double iMin, double iMax, double iStep);
  void SetRange(float iMin, float iMax, int iSteps);
  void SetRange(float iMin, float iMax, float iStep);
  void GetRange(float& oMin, float& oMax, int& oSteps) const;
  void GetRange(float& oMin, float& oMax, float& oStep) const;
  int GetVisibleTextWidth() const;
  void SetVisibleTextWidth(int iWidth);
  ZEPNotification* GetSpinnerModifyNotification();
};
