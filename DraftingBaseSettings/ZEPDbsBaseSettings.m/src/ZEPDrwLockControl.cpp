#include "ZEPDrwLockControl.h"

ZEPDrwLockControl::ZEPDrwLockControl(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo)
    : ZEPDrwLockDialog(iParent, iName, iInfo) {}

ZEPDlgControl* ZEPDrwLockControl::ValueControl() const {
  if (!_pDialog || !_pDialog->IsAKindOf(ZEPDlgControl::MetaObject()->GetName())) return nullptr;
  return ZEPSysDynamicCast<ZEPDlgControl>(_pDialog);
}

void ZEPDrwLockControl::SetMagnitude(ZEPDlgMagnitude iMagnitude) {
  if (ZEPDlgControl* c = ValueControl()) c->SetMagnitude(iMagnitude);
}

void ZEPDrwLockControl::SetUnit(ZEPDlgUnit iUnit) {
  if (ZEPDlgControl* c = ValueControl()) c->SetUnit(iUnit);
}

void ZEPDrwLockControl::SetPrecision(int iPrecision) {
  if (ZEPDlgControl* c = ValueControl()) c->SetPrecision(iPrecision, 0);
}

ZEPDlgMagnitude ZEPDrwLockControl::GetMagnitude() const {
  ZEPDlgControl* c = ValueControl();
  return c ? c->GetMagnitude() : 11;
}

ZEPDlgUnit ZEPDrwLockControl::GetUnit() const {
  ZEPDlgControl* c = ValueControl();
  return c ? c->GetUnit() : 45;
}

int ZEPDrwLockControl::GetPrecision() const {
  ZEPDlgControl* c = ValueControl();
  return c ? c->GetPrecision() : 1;
}
