#pragma once

#include <string>
#include <string_view>

namespace pelorus {

/// Control characters and bytes that are no UTF-8 as "\n", "\x1b": what a value holds must not steer a
/// terminal or break a line.
std::string printable(std::string_view text);

} // namespace pelorus
