#include "ZEPDrwLockFrame.h"

ZEPDrwLockFrame::ZEPDrwLockFrame(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                                 unsigned long iStyle)
    : ZEPDrwLockDialog(iParent, iName, iInfo) {
  _pDialog = new ZEPDlgFrame(this, iName + "locked", iStyle);
  Initialize();
}
