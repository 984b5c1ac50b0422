#include "ZEPDrwLockComboSymbol.h"

ZEPDrwLockComboSymbol::ZEPDrwLockComboSymbol(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                                             unsigned long iStyle)
    : ZEPDrwLockControl(iParent, iName, iInfo) {
  _pDialog = new ZEPComboSymbol(this, iName + "_dialog", iStyle, 1, 0);
  Initialize();
}

// The symbol combo is reached through its frame class first, as the toolkit hands it out.
ZEPComboSymbol* ZEPDrwLockComboSymbol::GetCombo() const {
  ZEPDlgFrame* frame = ZEPSysDynamicCast<ZEPDlgFrame>(_pDialog);
  return frame ? ZEPSysDynamicCast<ZEPComboSymbol>(frame) : nullptr;
}

unsigned int ZEPDrwLockComboSymbol::GetSelect() const {
  ZEPComboSymbol* c = GetCombo();
  return c ? c->GetSelect() : 0;
}

unsigned int ZEPDrwLockComboSymbol::GetSelectedSymbol(unsigned int& oSymbol) const {
  ZEPComboSymbol* c = GetCombo();
  return c ? c->GetSelectedSymbol(oSymbol) : 0;
}

void ZEPDrwLockComboSymbol::SetSelect(unsigned int iSymbol) {
  if (ZEPComboSymbol* c = GetCombo()) c->SetSelect(iSymbol);
}
