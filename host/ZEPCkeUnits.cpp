#include "ZEPCkeUnits.h"

#include <algorithm>
#include <iterator>

namespace {
const char* const kLengthUnits[] = {"METER",   "micron",  "MM",      "CM", "KM",   "INCH", "FOOT",
                                    "F_I_F64", "F_I_F16", "F_I_DEC", "DM", "YARD", "MILE"};
const char* const kAngleUnits[] = {"RADIAN", "DEGREE", "GRADE", "TURN"};

template <size_t N> bool Known(const char* const (&iTable)[N], const ZEPUnicodeString& iName) {
  return iName.IsEmpty() || std::any_of(std::begin(iTable), std::end(iTable),
                                        [&](const char* n) { return iName == n; });
}

struct UnitsState {
  ZEPUnicodeString length[5] = {"MM", "MM", "MM", "MM", "MM"};
  ZEPUnicodeString angle = "DEGREE";
  bool magnitudes = true;
  bool units = true;
  bool dictionary = false;
};
UnitsState& State() {
  static UnitsState state;
  return state;
}

bool ValidScale(ZEPCkeScale iScale) { return iScale >= 1 && iScale <= 5; }

// A plain type stands in for the magnitude when magnitudes are made unavailable.
ZEPICkeType_var TypeOf(bool iIsLength) {
  if (!State().dictionary) return nullptr;
  if (!State().magnitudes) return ZEPICkeType_var(std::make_shared<ZEPICkeType>());
  return ZEPICkeType_var(std::make_shared<ZEPICkeMagnitude>(iIsLength));
}
} // namespace

long ZEPICkeMagnitude::GetScaleUnit(ZEPICkeUnit_var& oUnit, ZEPCkeScale iScale) const {
  oUnit = nullptr;
  if (!State().units) return E_FAIL;
  ZEPUnicodeString name = State().angle;
  if (_bIsLength) {
    if (!ValidScale(iScale)) return E_FAIL;
    name = State().length[iScale - 1];
  }
  if (name.IsEmpty()) return E_FAIL;
  oUnit = ZEPICkeUnit_var(std::make_shared<ZEPICkeUnit>(name));
  return S_OK;
}

void ZEPCkeValueServices::ForceDictionaryInit() { State().dictionary = true; }

ZEPICkeType_var ZEPParmDictionary::LengthType() { return TypeOf(true); }
ZEPICkeType_var ZEPParmDictionary::AngleType() { return TypeOf(false); }

bool ZEPCkeUnitsSetup::SetLengthUnit(const ZEPUnicodeString& iName) {
  if (!Known(kLengthUnits, iName)) return false;
  for (ZEPUnicodeString& unit : State().length)
    unit = iName;
  return true;
}

bool ZEPCkeUnitsSetup::SetLengthUnit(ZEPCkeScale iScale, const ZEPUnicodeString& iName) {
  if (!ValidScale(iScale) || !Known(kLengthUnits, iName)) return false;
  State().length[iScale - 1] = iName;
  return true;
}

bool ZEPCkeUnitsSetup::SetAngleUnit(const ZEPUnicodeString& iName) {
  if (!Known(kAngleUnits, iName)) return false;
  State().angle = iName;
  return true;
}

ZEPUnicodeString ZEPCkeUnitsSetup::GetLengthUnit(ZEPCkeScale iScale) {
  return ValidScale(iScale) ? State().length[iScale - 1] : ZEPUnicodeString();
}

ZEPUnicodeString ZEPCkeUnitsSetup::GetAngleUnit() { return State().angle; }

void ZEPCkeUnitsSetup::SetMagnitudesAvailable(bool iAvailable) { State().magnitudes = iAvailable; }
void ZEPCkeUnitsSetup::SetUnitsAvailable(bool iAvailable) { State().units = iAvailable; }
void ZEPCkeUnitsSetup::Reset() { State() = UnitsState(); }
