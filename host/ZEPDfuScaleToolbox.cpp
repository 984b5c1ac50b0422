#include "ZEPDfuScaleToolbox.h"

#include <cctype>
#include <cerrno>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <map>
#include <string>
#include <utility>

namespace {
const double kRangeFactor[] = {1.0, 100.0, 10000.0, 0.01, 0.0001};

std::map<std::pair<int, int>, double>& Overrides() {
  static std::map<std::pair<int, int>, double> overrides;
  return overrides;
}

std::string Trim(const std::string& iText) {
  size_t b = 0, e = iText.size();
  while (b < e && std::isspace(static_cast<unsigned char>(iText[b])))
    ++b;
  while (e > b && std::isspace(static_cast<unsigned char>(iText[e - 1])))
    --e;
  return iText.substr(b, e - b);
}

// A plain decimal number, nothing else: no sign other than '-', no hexadecimal, no infinity.
bool ReadNumber(const std::string& iText, double& oValue) {
  std::string t = Trim(iText);
  if (t.empty()) return false;
  for (char c : t)
    if (!std::isdigit(static_cast<unsigned char>(c)) && c != '.' && c != 'e' && c != 'E' &&
        c != '-' && c != '+')
      return false;
  if (!std::isdigit(static_cast<unsigned char>(t[0])) && t[0] != '.') return false;
  errno = 0;
  char* end = nullptr;
  double v = std::strtod(t.c_str(), &end);
  if (errno != 0 || !end || *end != '\0' || !std::isfinite(v)) return false;
  oValue = v;
  return true;
}

std::string Format(double iValue) {
  char buf[64];
  std::snprintf(buf, sizeof buf, "%g", iValue);
  return buf;
}
} // namespace

long ZEPDfuScaleAndUnitsToolbox::DecimalToFractionConvertor(double iValue, double& oNumerator,
                                                            double& oDenominator, int iPrecision) {
  if (!std::isfinite(iValue)) return E_FAIL;
  if (iValue == 0.0) {
    oNumerator = 0.0;
    oDenominator = 1.0;
    return S_OK;
  }
  const double target = std::fabs(iValue);
  const double tolerance = target * std::pow(10.0, -(iPrecision < 0 ? 0 : iPrecision));
  // Continued fraction convergents h/k of the value.
  double h0 = 1.0, h1 = std::floor(target), k0 = 0.0, k1 = 1.0, rest = target - std::floor(target);
  for (int i = 0; i < 64 && std::fabs(target - h1 / k1) > tolerance; ++i) {
    if (rest <= 0.0) break;
    const double inverse = 1.0 / rest;
    const double a = std::floor(inverse);
    rest = inverse - a;
    const double h2 = a * h1 + h0, k2 = a * k1 + k0;
    h0 = h1;
    h1 = h2;
    k0 = k1;
    k1 = k2;
    if (k1 > 1e12) return E_FAIL;
  }
  if (std::fabs(target - h1 / k1) > tolerance) return E_FAIL;
  oNumerator = iValue < 0 ? -h1 : h1;
  oDenominator = k1;
  return S_OK;
}

long ZEPDfuScaleAndUnitsToolbox::ConvertScaleFromStringToDouble(const ZEPUnicodeString& iText,
                                                                ZEPUnicodeString& oText,
                                                                double& oValue, int& oForm) {
  const std::string text = iText.str();
  const size_t colon = text.find(':');
  const size_t slash = text.find('/');
  double value = 0.0;
  int form = 0;
  std::string normal;
  if (colon != std::string::npos || slash != std::string::npos) {
    if (colon != std::string::npos && slash != std::string::npos) return E_FAIL;
    const size_t at = colon != std::string::npos ? colon : slash;
    double a = 0.0, b = 0.0;
    if (!ReadNumber(text.substr(0, at), a) || !ReadNumber(text.substr(at + 1), b)) return E_FAIL;
    if (a <= 0.0 || b <= 0.0) return E_FAIL;
    value = a / b;
    form = colon != std::string::npos ? 1 : 2;
    normal = Format(a) + (form == 1 ? ":" : "/") + Format(b);
  } else {
    if (!ReadNumber(text, value)) return E_FAIL;
    normal = Format(value);
  }
  if (!(value > 0.0) || !std::isfinite(value)) return E_FAIL;
  oValue = value;
  oText = normal;
  oForm = form;
  return S_OK;
}

ZEPDibTolerances::ZEPDibTolerances(ZEPCkeScale iRange) : _range(iRange) {}

double ZEPDibTolerances::GetTolerance(int iKind) const {
  auto it = Overrides().find({static_cast<int>(_range), iKind});
  if (it != Overrides().end()) return it->second;
  const int r = static_cast<int>(_range);
  const double factor = r >= 1 && r <= 5 ? kRangeFactor[r - 1] : 1.0;
  if (iKind == 6) return 0.001 / factor;
  if (iKind == 7) return 1000.0 / factor;
  return 0.0;
}

void ZEPScaleToolboxSetup::SetTolerance(ZEPCkeScale iRange, int iKind, double iValue) {
  Overrides()[{static_cast<int>(iRange), iKind}] = iValue;
}

void ZEPScaleToolboxSetup::Reset() { Overrides().clear(); }
