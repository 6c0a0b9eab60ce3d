#pragma once

#include <cstddef>
#include <string_view>

namespace pelorus {

/// Length of the longest start of the text that is well-formed UTF-8 (RFC 3629) without NUL.
std::size_t validUtf8Prefix(std::string_view text);

} // namespace pelorus
