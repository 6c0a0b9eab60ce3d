#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// State of the radio resource control.
struct LogCode_0xD0E0 {
    static constexpr Field version = u8(13);
    static constexpr Field mode = u8(14);
    static constexpr std::size_t expectedLength = 15;
    static_assert(mode.end() == expectedLength);

    static constexpr std::int64_t knownVersion = 1; // of other versions the mode cannot be told
};

} // namespace pelorus
