#pragma once

#include "platform/Value.h"

#include <cstddef>
#include <span>
#include <string>

namespace pelorus {

/// Reads a binary list: "bplist00", objects, a table of their offsets, a trailer of 32 bytes; all numbers
/// big-endian. Nil, with one line in `why`, for a list that is malformed, cut short or passes the limits.
///
/// Binary lists are what the telephony server streams, several a second. To check one for libplist, which
/// trusts them, takes all that reading it takes, so it is read here.
Value readBinaryPropertyList(std::span<const std::byte> bytes, std::string& why);

} // namespace pelorus
