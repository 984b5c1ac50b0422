#include "ZEPDrwLockCombo.h"

namespace {
const char* const kPath = "DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEPDrwLockCombo";
}

ZEPDrwLockCombo::ZEPDrwLockCombo(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo,
                                 unsigned long iStyle)
    : ZEPDrwLockControl(iParent, iName, iInfo) {
  _pDialog = new ZEPDlgCombo(this, iName + "_dialog", iStyle);
  Initialize();
}

ZEPDlgCombo* ZEPDrwLockCombo::GetCombo() const { return ZEPSysDynamicCast<ZEPDlgCombo>(_pDialog); }

void ZEPDrwLockCombo::ClearLine() {
  ZEPDlgCombo* pDlgCmb = GetCombo();
  if (!pDlgCmb) return Check_Pointer_Failed__("pDlgCmb", kPath, __LINE__, nullptr);
  pDlgCmb->ClearLine();
}

void ZEPDrwLockCombo::SetVisibleTextWidth(int iWidth) {
  ZEPDlgCombo* pDlgCmb = GetCombo();
  if (!pDlgCmb) return Check_Pointer_Failed__("pDlgCmb", kPath, __LINE__, nullptr);
  pDlgCmb->SetVisibleTextWidth(iWidth);
}

int ZEPDrwLockCombo::SetLine(const ZEPUnicodeString& iText, const ZEPString& iIconName) {
  ZEPDlgCombo* pDlgCmb = GetCombo();
  if (!pDlgCmb) {
    Check_Pointer_Failed__("pDlgCmb", kPath, __LINE__, nullptr);
    return -1;
  }
  if (iIconName.empty()) return pDlgCmb->SetLine(iText, -1, 0x40);
  return pDlgCmb->SetLine(iText, iIconName, -1, 0x40);
}

int ZEPDrwLockCombo::SetSelect(const ZEPUnicodeString& iText, int iNotify) {
  ZEPDlgCombo* pDlgCmb = GetCombo();
  if (!pDlgCmb) {
    Check_Pointer_Failed__("pDlgCmb", kPath, __LINE__, nullptr);
    return -1;
  }
  return pDlgCmb->SetSelect(iText, iNotify);
}
