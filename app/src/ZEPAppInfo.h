// Name and version of the host application.
#pragma once

namespace zepapp {
inline constexpr const char* kAppName = "drafting-options";
inline constexpr const char* kAppVersion = "0.1.0";
} // namespace zepapp
