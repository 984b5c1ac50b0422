#include "ZEPDrwLockComboColor.h"

ZEPDrwLockComboColor::ZEPDrwLockComboColor(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo)
    : ZEPDrwLockControl(iParent, iName, iInfo) {
  _pDialog = new ZEPComboColor(this, iName + "_dialog", 0, 255, 255, 255, 0, 0, 0);
  Initialize();
}

ZEPComboColor* ZEPDrwLockComboColor::GetCombo() const { return ZEPSysDynamicCast<ZEPComboColor>(_pDialog); }

int ZEPDrwLockComboColor::GetSelectedColor(unsigned int* oRed, unsigned int* oGreen, unsigned int* oBlue) const {
  ZEPComboColor* c = GetCombo();
  return c ? c->GetSelectedColor(oRed, oGreen, oBlue) : 0;
}

int ZEPDrwLockComboColor::GetSelectedColor(unsigned int* oRed, unsigned int* oGreen, unsigned int* oBlue,
                                           ZEPUnicodeString* oName) const {
  if (ZEPComboColor* c = GetCombo()) c->GetSelectedColor(oRed, oGreen, oBlue, oName);
  return 0;
}

void ZEPDrwLockComboColor::SetSelectedColor(unsigned int iRed, unsigned int iGreen, unsigned int iBlue) {
  if (ZEPComboColor* c = GetCombo()) c->SetSelectedColor(iRed, iGreen, iBlue);
}

void ZEPDrwLockComboColor::SetVisibleTextWidth(int iWidth) {
  ZEPComboColor* c = GetCombo();
  if (c && c->GetCombo()) c->GetCombo()->SetVisibleTextWidth(iWidth);
}
