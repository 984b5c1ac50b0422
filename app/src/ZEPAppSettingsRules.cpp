#include "ZEPAppSettingsRules.h"

#include "ZEPAppPages.h"
#include "ZEPDrwSettingsServices.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <map>
#include <set>
#include <type_traits>
#include <variant>

namespace zepapp {

namespace {

// The limits of the controls, by stored attribute. Lengths are millimetres at the normal scale;
// a per-range length scales with its range as its spinner does.
struct Limits {
  double min, max;
  bool minExcluded;                // a grid spacing must be more than 0
  bool perRange;                   // the maximum follows the scale range of the value
  std::vector<double> oneOf = {};  // a combo: the codes of its lines
};
const std::map<std::string, Limits>& KnownLimits() {
  static const std::map<std::string, Limits> limits = {
      {"DrwViewAxisLength", {0.0, 100000.0, false, false}},
      {"DrwDefaultOffsetBetViews", {0.0, 10000.0, false, false}},
      {"Drw_settings_GridPrimarySpacing", {0.0, 100000.0, true, true}},
      {"Drw_settings_GridVPrimarySpacing", {0.0, 10000.0, true, true}},
      {"Drw_settings_GridSecondaryStep", {1.0, 100000.0, false, false}},
      {"Drw_settings_GridVSecondaryStep", {1.0, 100000.0, false, false}},
      // The general page's unit lines: millimetre, centimetre, inch.
      {"DrwPaperLengthUnit", {1.0, 5.0, false, false, {1.0, 3.0, 5.0}}},
      {"DrwGeoCstRefSize", {0.0, 100000.0, false, false}},
      {"DrwDimConstantOffsetValue", {-1000.0, 1000.0, false, false}},
      {"DrwDimOffsetRefMM", {-1000.0, 1000.0, false, false}},
      {"DrwDimOffsetBetMM", {-1000.0, 1000.0, false, false}},
      {"DrwDimOffsetRefDeg", {-180.0, 180.0, false, false}},
      {"DrwDimOffsetBetDeg", {-180.0, 180.0, false, false}},
  };
  return limits;
}

// The largest value a length spinner takes at a scale range, as the pages set it.
double RangeMaximum(double iMax, int iRange) {
  ZEPDlgSpinner probe(nullptr, "limitsProbe", ZEPDlgSpnDouble);
  ZEPDrwSettingsServices::SetLengthMinMaxStep(&probe, static_cast<ZEPCkeScale>(iRange), 0, 0.0, iMax, 1.0);
  double lo = 0, hi = iMax / 1000.0, step = 0;
  probe.GetMinMaxStep(lo, hi, step);
  return hi * 1000.0; // the spinner works in metres
}

std::string Accepted(const Limits& iLimits, double iMax) {
  if (!iLimits.oneOf.empty()) {
    std::string text = "one of";
    for (double v : iLimits.oneOf) text += " " + FormatNumber(v);
    return text;
  }
  return (iLimits.minExcluded ? "more than " : "from ") + FormatNumber(iLimits.min) + " to " + FormatNumber(iMax);
}

// Why one value is refused; empty when accepted.
std::string Refusal(const Limits& iLimits, double iValue, double iMax) {
  const bool ok = iLimits.oneOf.empty()
                ? (iLimits.minExcluded ? iValue > iLimits.min : iValue >= iLimits.min) && iValue <= iMax
                : std::find(iLimits.oneOf.begin(), iLimits.oneOf.end(), iValue) != iLimits.oneOf.end();
  return ok ? "" : FormatNumber(iValue) + " is outside the control's limits (" + Accepted(iLimits, iMax) + ")";
}

template <class Values> std::string CheckEach(const Values& iValues, const Limits& iLimits, bool iFlag) {
  for (std::size_t i = 0; i < iValues.size(); ++i) {
    const double v = static_cast<double>(iValues[i]);
    std::string why;
    if (iFlag) {
      if (v != 0.0 && v != 1.0) why = FormatNumber(v) + " is not a check state (0 or 1)";
    } else {
      const double max = iLimits.perRange ? RangeMaximum(iLimits.max, static_cast<int>(i) + 1) : iLimits.max;
      why = Refusal(iLimits, v, max);
    }
    if (why.empty()) continue;
    return iValues.size() == 1 ? why : "value " + std::to_string(i + 1) + ": " + why;
  }
  return "";
}

constexpr std::size_t kText = 3; // the alternative of ZEPAppValue that holds texts
static_assert(std::is_same_v<std::variant_alternative_t<kText, ZEPAppValue>, std::vector<std::string>>);

// The alternative of ZEPAppValue a stored kind is kept as; npos when the page does not say.
// Every kind that is not a number is a list of texts.
std::size_t TypeIndex(ZEPAppStored iKind) {
  if (iKind == ZEPAppStored::Double) return 0;
  if (iKind == ZEPAppStored::Int) return 1;
  if (iKind == ZEPAppStored::UInt) return 2;
  if (iKind == ZEPAppStored::Unsupported) return std::size_t(-1);
  return kText;
}

} // namespace

std::string FormatNumber(double iValue) {
  // Plain digits where people read them so, exponents for the very large and very small; the
  // shortest digits that read back to the same double either way.
  const double magnitude = std::fabs(iValue);
  const bool plain = magnitude == 0.0 || (magnitude >= 1e-6 && magnitude < 1e21);
  char buffer[128]; // a plain number below 1e21 or an exponent form needs far less
  const auto result = std::to_chars(buffer, buffer + sizeof buffer, iValue,
                                    plain ? std::chars_format::fixed : std::chars_format::scientific);
  return result.ec == std::errc() ? std::string(buffer, result.ptr) : std::to_string(iValue);
}

std::vector<ZEPAppAttrRule> AppSettingRules() {
  std::vector<ZEPAppAttrRule> rules;
  for (const ZEPAppSetting& s : AppSettings()) {
    const ZEPAppPage* page = TablePage(s);
    const ZEPAppStored kind = StoredKindOf(s);
    ZEPAppAttrRule rule;
    rule.repository = s.repository;
    rule.attribute = s.stored;
    rule.count = s.defaults.size();
    rule.type = TypeIndex(kind); // any kind when the page does not say
    if (rule.type == kText) {
      // One text, or a list of any length; no limits either.
      rule.count = kind == ZEPAppStored::TextList ? kAnyCount : 1;
      rules.push_back(std::move(rule));
      continue;
    }
    const bool flag = page && page->flags.count(s.attribute) != 0;
    auto known = KnownLimits().find(s.stored);
    if (flag || known != KnownLimits().end()) {
      const Limits limits = known != KnownLimits().end() ? known->second : Limits{0, 1, false, false};
      rule.check = [limits, flag](const ZEPAppValue& iValue) {
        return std::visit(
            [&](const auto& values) -> std::string {
              using T = typename std::decay_t<decltype(values)>::value_type;
              if constexpr (std::is_same_v<T, std::string>) return "a text where a number is expected";
              else return CheckEach(values, limits, flag);
            },
            iValue);
      };
    }
    rules.push_back(std::move(rule));
  }
  return rules;
}

} // namespace zepapp
