#include "ZEPDrwLockEditor.h"

ZEPDrwLockEditor::ZEPDrwLockEditor(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                                   unsigned long iStyle)
    : ZEPDrwLockControl(iParent, iName, iInfo) {
  _pDialog = new ZEPDlgEditor(this, iName + "_dialog", iStyle);
  Initialize();
}

ZEPDlgEditor* ZEPDrwLockEditor::GetEditor() const { return ZEPSysDynamicCast<ZEPDlgEditor>(_pDialog); }
