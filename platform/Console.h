#pragma once

#include <functional>
#include <string_view>

namespace pelorus {

/// Where the decoders' console output goes, one line a call. Chosen by the program's entry; without one (the
/// default) nothing is formatted.
void setConsole(std::function<void(std::string_view line)> chosen);
bool consoleListens();
void consoleLine(std::string_view line);

} // namespace pelorus
