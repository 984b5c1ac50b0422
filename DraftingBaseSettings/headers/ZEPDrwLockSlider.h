#pragma once

#include "ZEPDrwLockControl.h"

class ZEPDrwLockSlider : public ZEPDrwLockControl {
public:
  ZEPDrwLockSlider(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                   unsigned long iStyle = 0);
  float GetCurrentValue() const;
  ZEPNotification* GetSliderDragNotification();
  float SetCurrentValue(float iValue, int iNotify = 1);
  void SetRange(float iMin, float iMax, int iSteps);

private:
  ZEPDlgSlider* Slider() const;
};
