// Combo of the drawing scale ranges the host has activated, one line per range named by the
// scales service, in ascending range order. Hidden when there is only one range to choose.
#pragma once

#include "ZEPHost.h"

class ZEP2DBaseRangeCmb : public ZEPDlgCombo {
  ZEP_DECLARE_CLASS
public:
  ZEP2DBaseRangeCmb(ZEPDialog* iParent, const ZEPString& iName);
  ~ZEP2DBaseRangeCmb() override;
  // The combo is only created by its constructor: no object.
  static ZEPBaseUnknown* CreateItself();

  // The range (1 to 5) of the selected line; -1 without the scales service.
  int GetSelect() const;
  // Selects the line of GetMatchingRange(iIdx), never notifying (iNotify is ignored);
  // answers iIdx, or -1 when that range has no line or without the scales service.
  int SetSelect(int iIdx, int iNotify);
  // 1 to 4 map to themselves, any other value to 5.
  static ZEPCkeScale GetMatchingRange(int iIdx);

private:
  ZEPRawCollint _activatedScales; // as the scales service listed them at construction
};
