#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace pelorus {

/// Length of the longest start of the text that is well-formed UTF-8 (RFC 3629) without NUL.
std::size_t validUtf8Prefix(std::string_view text);

/// Makes `out` the UTF-8 of big-endian UTF-16, two bytes a unit. A surrogate without its other half, which is
/// no character, becomes U+FFFD.
void utf8FromUtf16(std::string_view bigEndian, std::string& out);

} // namespace pelorus
