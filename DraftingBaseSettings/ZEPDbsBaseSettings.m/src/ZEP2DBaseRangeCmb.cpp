#include "ZEP2DBaseRangeCmb.h"

namespace {
const char* const kPath = "DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEP2DBaseRangeCmb";
}

ZEP_IMPLEMENT_CLASS_EX(ZEP2DBaseRangeCmb, ZEPDlgCombo, "ZEPnull", "DraftingBaseSettings")

ZEPBaseUnknown* ZEP2DBaseRangeCmb::CreateItself() { return nullptr; }

ZEP2DBaseRangeCmb::ZEP2DBaseRangeCmb(ZEPDialog* iParent, const ZEPString& iName)
    : ZEPDlgCombo(iParent, iName, 0x40000) {
  ZEPICkeScalesServices_var spScaleServices = ZEPGlobalFunctions2::GetScalesServices();
  if (!spScaleServices) {
    Check_Handler_Failed__("spScaleServices", kPath, __LINE__, nullptr);
    return;
  }
  _activatedScales = spScaleServices->GetActivatedScales();

  int initialRange = 1;
  if (_activatedScales.Size() >= 2) {
    int current = spScaleServices->GetCurrentScale();
    if (current >= 1 && current <= 5) initialRange = current;
  } else {
    SetVisibility(ZEPDlgHide); // nothing to choose
  }
  SetVisibleTextWidth(8);

  for (int k = 1; k <= 5; ++k)
    if (_activatedScales.Locate(k, 1) > 0)
      SetLine(spScaleServices->GetScaleName(static_cast<ZEPCkeScale>(k)), -1, 0x40);
  // Fails for an activated number outside 1 to 5 or a repeated one.
  if (GetLineCount() != _activatedScales.Size())
    Check_TRUE_Failed__("GetLineCount()==_activatedScales.Size()", kPath, __LINE__, nullptr);

  SetSelect(initialRange, 1);
}

ZEP2DBaseRangeCmb::~ZEP2DBaseRangeCmb() { _activatedScales.RemoveAll(1); }

int ZEP2DBaseRangeCmb::GetSelect() const {
  ZEPICkeScalesServices_var spScaleServices = ZEPGlobalFunctions2::GetScalesServices();
  if (!spScaleServices) {
    Check_Handler_Failed__("spScaleServices", kPath, __LINE__, nullptr);
    return -1;
  }
  ZEPUnicodeString text;
  GetLine(text, ZEPDlgCombo::GetSelect());
  // Lines are found by their names; whatever is none of the others is range 1.
  for (int k = 2; k <= 5; ++k)
    if (text == spScaleServices->GetScaleName(static_cast<ZEPCkeScale>(k))) return k;
  return 1;
}

int ZEP2DBaseRangeCmb::SetSelect(int iIdx, int /*iNotify*/) {
  ZEPICkeScalesServices_var spScaleServices = ZEPGlobalFunctions2::GetScalesServices();
  if (!spScaleServices) {
    Check_Handler_Failed__("spScaleServices", kPath, __LINE__, nullptr);
    return -1;
  }
  if (ZEPDlgCombo::SetSelect(spScaleServices->GetScaleName(GetMatchingRange(iIdx)), 0) < 0) {
    Check_TRUE_Failed__(
        "0<=ZEPDlgCombo::SetSelect(spScaleServices->GetScaleName(GetMatchingRange(iIdx)), 0)",
        kPath, __LINE__, nullptr);
    return -1;
  }
  return iIdx;
}

ZEPCkeScale ZEP2DBaseRangeCmb::GetMatchingRange(int iIdx) {
  return iIdx >= 1 && iIdx <= 4 ? static_cast<ZEPCkeScale>(iIdx) : ZEPCkeScaleExtraSmall;
}
