#pragma once

#include "ZEPDrwLockControl.h"

class ZEPDrwLockComboSymbol : public ZEPDrwLockControl {
public:
  ZEPDrwLockComboSymbol(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                        unsigned long iStyle = 0);
  ZEPComboSymbol* GetCombo() const;
  unsigned int GetSelect() const;
  unsigned int GetSelectedSymbol(unsigned int& oSymbol) const;
  void SetSelect(unsigned int iSymbol);
};
