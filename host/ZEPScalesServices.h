// The scales service: which drawing scale ranges are activated, their names and the
// range the user works in.
#pragma once

#include "ZEPCkeUnits.h"

#include <vector>

class ZEPICkeScalesServices {
public:
  virtual ~ZEPICkeScalesServices() = default;
  ZEPRawCollint GetActivatedScales() const;
  int GetCurrentScale() const;
  // "Normal", "Large", "Extra large", "Small", "Extra small" for 1 to 5; empty otherwise.
  ZEPUnicodeString GetScaleName(ZEPCkeScale iScale) const;
};
using ZEPICkeScalesServices_var = ZEPCkeVar<ZEPICkeScalesServices>;

class ZEPGlobalFunctions2 {
public:
  // Null when the service is unavailable.
  static ZEPICkeScalesServices_var GetScalesServices();
};

// Configuration of the scales service, for the application and for tests.
class ZEPScalesSetup {
public:
  // Listed as given: any order, any values.
  static void SetActivatedScales(const std::vector<int>& iScales);
  static void SetCurrentScale(int iScale);
  static void SetAvailable(bool iAvailable);
  // How many times GetCurrentScale was asked since the last reset.
  static int CurrentScaleRequests();
  // All five ranges activated, current scale 1, available.
  static void Reset();
};
