#include "ZEPDrwLockSlider.h"

ZEPDrwLockSlider::ZEPDrwLockSlider(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                                   unsigned long iStyle)
    : ZEPDrwLockControl(iParent, iName, iInfo) {
  _pDialog = new ZEPDlgSlider(this, iName + "_dialog", iStyle);
  Initialize();
}

ZEPDlgSlider* ZEPDrwLockSlider::Slider() const { return ZEPSysDynamicCast<ZEPDlgSlider>(_pDialog); }

float ZEPDrwLockSlider::GetCurrentValue() const {
  ZEPDlgSlider* s = Slider();
  return s ? s->GetCurrentValue() : 0.0f;
}

ZEPNotification* ZEPDrwLockSlider::GetSliderDragNotification() {
  ZEPDlgSlider* s = Slider();
  return s ? s->GetSliderDragNotification() : nullptr;
}

float ZEPDrwLockSlider::SetCurrentValue(float iValue, int iNotify) {
  ZEPDlgSlider* s = Slider();
  return s ? s->SetCurrentValue(iValue, iNotify) : 0.0f;
}

void ZEPDrwLockSlider::SetRange(float iMin, float iMax, int iSteps) {
  if (ZEPDlgSlider* s = Slider()) s->SetRange(iMin, iMax, iSteps);
}
