// The drafting scale toolbox (scale ratios as fractions and as text) and the modeller
// tolerances of each drawing scale range.
#pragma once

#include "ZEPCkeUnits.h"

class ZEPDfuScaleAndUnitsToolbox {
public:
  // oNumerator / oDenominator equal to iValue within a relative 10^-iPrecision, with the
  // smallest denominator found; a negative value gives a negative numerator. E_FAIL, outputs
  // untouched, for a value that is not finite or has no such fraction (denominator above 1e12).
  static long DecimalToFractionConvertor(double iValue, double& oNumerator, double& oDenominator,
                                         int iPrecision);
  // Reads a scale typed by the user: "1:50" and "1/50" (ratios), "2" and "0.5" (numbers),
  // blanks around the parts allowed. On success oValue is the positive finite scale, oText its
  // normal form ("1:50", "0.5") and oForm 1 for "a:b", 2 for "a/b", 0 for a number.
  // E_FAIL, outputs untouched, for anything else (garbage, zero, negative, a zero divisor).
  static long ConvertScaleFromStringToDouble(const ZEPUnicodeString& iText, ZEPUnicodeString& oText,
                                             double& oValue, int& oForm);
};

// Tolerances of the modeller at one drawing scale range. Kind 6 is the smallest length the
// modeller keeps apart and kind 7 the largest it represents, both relative to the range's unit
// length: a scale ratio of the range lies within 1 / tolerance(7) and 1 / tolerance(6).
class ZEPDibTolerances {
public:
  explicit ZEPDibTolerances(ZEPCkeScale iRange);
  // The tolerance of that kind at the range; 0.0 for an unknown kind.
  double GetTolerance(int iKind) const;

private:
  ZEPCkeScale _range;
};

// Configuration of the tolerances, for the application and for tests. By default, at range k
// with length factor f (1, 100, 10000, 0.01, 0.0001): tolerance(6) = 0.001 / f and
// tolerance(7) = 1000 / f, so the ratios of range k lie within 0.001 f and 1000 f.
class ZEPScaleToolboxSetup {
public:
  // Any value, including zero, negative or infinite ones: what a misconfigured host answers.
  static void SetTolerance(ZEPCkeScale iRange, int iKind, double iValue);
  // The default tolerances.
  static void Reset();
};
