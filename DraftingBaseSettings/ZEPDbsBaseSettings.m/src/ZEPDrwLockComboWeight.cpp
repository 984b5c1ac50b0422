#include "ZEPDrwLockComboWeight.h"

ZEPDrwLockComboWeight::ZEPDrwLockComboWeight(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                                             unsigned long iStyle, unsigned int iValue)
    : ZEPDrwLockControl(iParent, iName, iInfo) {
  _pDialog = new ZEPComboWeight(this, iName + "_dialog", iStyle, iValue, 0);
  Initialize();
}

ZEPComboWeight* ZEPDrwLockComboWeight::GetCombo() const { return ZEPSysDynamicCast<ZEPComboWeight>(_pDialog); }

unsigned int ZEPDrwLockComboWeight::GetSelect() const {
  ZEPComboWeight* c = GetCombo();
  return c ? c->GetSelect() : 1;
}

void ZEPDrwLockComboWeight::SetSelect(unsigned int iWeight) {
  if (ZEPComboWeight* c = GetCombo()) c->SetSelect(iWeight);
}

void ZEPDrwLockComboWeight::SetVisibleTextHeight(int iHeight) {
  ZEPComboWeight* c = GetCombo();
  if (c && c->GetCombo()) c->GetCombo()->SetVisibleTextHeight(iHeight);
}

void ZEPDrwLockComboWeight::SetVisibleTextWidth(int iWidth) {
  ZEPComboWeight* c = GetCombo();
  if (c && c->GetCombo()) c->GetCombo()->SetVisibleTextWidth(iWidth);
}
