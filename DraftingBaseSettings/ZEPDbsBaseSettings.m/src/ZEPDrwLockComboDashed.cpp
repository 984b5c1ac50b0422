#include "ZEPDrwLockComboDashed.h"

namespace {
// The break line: 0 in the settings, entry 8 of the combo.
const unsigned int kBreakLineEntry = 8;
} // namespace

ZEPDrwLockComboDashed::ZEPDrwLockComboDashed(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                                             char iWithBreakLine, unsigned long iStyle, unsigned int iValue)
    : ZEPDrwLockControl(iParent, iName, iInfo) {
  auto* combo = new ZEPComboDashed(this, iName + "_dialog", iStyle, iValue, 0);
  if (iWithBreakLine != 0) combo->AddOtherType("S_DrwBreakLine8", 1);
  _pDialog = combo;
  Initialize();
}

ZEPComboDashed* ZEPDrwLockComboDashed::GetCombo() const { return ZEPSysDynamicCast<ZEPComboDashed>(_pDialog); }

unsigned int ZEPDrwLockComboDashed::GetSelect() const {
  ZEPComboDashed* c = GetCombo();
  if (!c) return 0;
  unsigned int type = c->GetSelect();
  return type == kBreakLineEntry ? 0 : type;
}

void ZEPDrwLockComboDashed::SetSelect(unsigned int iType) {
  if (ZEPComboDashed* c = GetCombo()) c->SetSelect(iType == 0 ? kBreakLineEntry : iType);
}

void ZEPDrwLockComboDashed::SetVisibleTextHeight(int iHeight) {
  ZEPComboDashed* c = GetCombo();
  if (c && c->GetCombo()) c->GetCombo()->SetVisibleTextHeight(iHeight);
}

void ZEPDrwLockComboDashed::SetVisibleTextWidth(int iWidth) {
  ZEPComboDashed* c = GetCombo();
  if (c && c->GetCombo()) c->GetCombo()->SetVisibleTextWidth(iWidth);
}
