#include "ZEPScalesServices.h"

namespace {
struct ScalesState {
  std::vector<int> activated = {1, 2, 3, 4, 5};
  int current = 1;
  bool available = true;
  int currentRequests = 0;
};
ScalesState& State() {
  static ScalesState state;
  return state;
}
} // namespace

ZEPRawCollint ZEPICkeScalesServices::GetActivatedScales() const {
  ZEPRawCollint scales;
  for (int s : State().activated)
    scales.Append(s);
  return scales;
}

int ZEPICkeScalesServices::GetCurrentScale() const {
  ++State().currentRequests;
  return State().current;
}

ZEPUnicodeString ZEPICkeScalesServices::GetScaleName(ZEPCkeScale iScale) const {
  static const char* const names[] = {"Normal", "Large", "Extra large", "Small", "Extra small"};
  return iScale >= 1 && iScale <= 5 ? ZEPUnicodeString(names[iScale - 1]) : ZEPUnicodeString();
}

ZEPICkeScalesServices_var ZEPGlobalFunctions2::GetScalesServices() {
  if (!State().available) return nullptr;
  return ZEPICkeScalesServices_var(std::make_shared<ZEPICkeScalesServices>());
}

void ZEPScalesSetup::SetActivatedScales(const std::vector<int>& iScales) {
  State().activated = iScales;
}
void ZEPScalesSetup::SetCurrentScale(int iScale) { State().current = iScale; }
void ZEPScalesSetup::SetAvailable(bool iAvailable) { State().available = iAvailable; }
int ZEPScalesSetup::CurrentScaleRequests() { return State().currentRequests; }
void ZEPScalesSetup::Reset() { State() = ScalesState(); }
