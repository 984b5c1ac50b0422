#include "ZEPDrwLockSpinner.h"

ZEPDrwLockSpinner::ZEPDrwLockSpinner(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                                     unsigned long iStyle)
    : ZEPDrwLockControl(iParent, iName, iInfo) {
  _pDialog = new ZEPDlgSpinner(this, iName + "_dialog", iStyle);
  Initialize();
}

ZEPDlgSpinner* ZEPDrwLockSpinner::GetSpinner() const { return ZEPSysDynamicCast<ZEPDlgSpinner>(_pDialog); }

double ZEPDrwLockSpinner::GetValue() const {
  ZEPDlgSpinner* s = GetSpinner();
  return s ? s->GetValue() : 0.0;
}

void ZEPDrwLockSpinner::SetValue(double iValue, int iNotify) {
  if (ZEPDlgSpinner* s = GetSpinner()) s->SetValue(iValue, iNotify);
}

float ZEPDrwLockSpinner::GetCurrentValue() const {
  ZEPDlgSpinner* s = GetSpinner();
  return s ? s->GetCurrentValue() : 0.0f;
}

float ZEPDrwLockSpinner::SetCurrentValue(float iValue, int iNotify) {
  ZEPDlgSpinner* s = GetSpinner();
  return s ? s->SetCurrentValue(iValue, iNotify) : 0.0f;
}

const char* ZEPDrwLockSpinner::GetFormat() const {
  ZEPDlgSpinner* s = GetSpinner();
  return s ? s->GetFormat() : nullptr;
}

void ZEPDrwLockSpinner::SetFormat(const char* iFormat) {
  if (ZEPDlgSpinner* s = GetSpinner()) s->SetFormat(iFormat);
}

void ZEPDrwLockSpinner::GetMinMaxStep(double& oMin, double& oMax, double& oStep) const {
  if (ZEPDlgSpinner* s = GetSpinner()) s->GetMinMaxStep(oMin, oMax, oStep);
}

void ZEPDrwLockSpinner::SetMinMaxStep(double iMin, double iMax, double iStep) {
  if (ZEPDlgSpinner* s = GetSpinner()) s->SetMinMaxStep(iMin, iMax, iStep, 0);
}

void ZEPDrwLockSpinner::SetRange(float iMin, float iMax, int iSteps) {
  if (ZEPDlgSpinner* s = GetSpinner()) s->SetRange(iMin, iMax, iSteps, 1);
}

void ZEPDrwLockSpinner::SetRange(float iMin, float iMax, float iStep) {
  if (ZEPDlgSpinner* s = GetSpinner()) s->SetRange(iMin, iMax, iStep, 0);
}

void ZEPDrwLockSpinner::GetRange(float& oMin, float& oMax, int& oSteps) const {
  if (ZEPDlgSpinner* s = GetSpinner()) s->GetRange(oMin, oMax, oSteps);
}

void ZEPDrwLockSpinner::GetRange(float& oMin, float& oMax, float& oStep) const {
  if (ZEPDlgSpinner* s = GetSpinner()) s->GetRange(oMin, oMax, oStep);
}

int ZEPDrwLockSpinner::GetVisibleTextWidth() const {
  ZEPDlgSpinner* s = GetSpinner();
  return s ? s->GetVisibleTextWidth() : 0;
}

void ZEPDrwLockSpinner::SetVisibleTextWidth(int iWidth) {
  if (ZEPDlgSpinner* s = GetSpinner()) s->SetVisibleTextWidth(iWidth);
}

ZEPNotification* ZEPDrwLockSpinner::GetSpinnerModifyNotification() {
  ZEPDlgSpinner* s = GetSpinner();
  return s ? s->GetSpinnerModifyNotification() : nullptr;
}
