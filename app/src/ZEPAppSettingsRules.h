// What the application accepts as a stored value of each setting: the kind and count of its
// row in ZEPAppSettings.def and the limits of the control that shows it.
#pragma once

#include "ZEPAppSettingsFile.h"

#include <string>
#include <vector>

namespace zepapp {

// One rule per row of ZEPAppSettings.def. Rows whose limits are not known here get a kind and
// count check only.
std::vector<ZEPAppAttrRule> AppSettingRules();

// A number as it reads back to the same double: the shortest form, no fixed buffer, no
// grouping ("0.1", "1e+308", "-5").
std::string FormatNumber(double iValue);

} // namespace zepapp
