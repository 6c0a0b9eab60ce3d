#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Whether UMTS ciphering is on.
struct LogCode_0x4157 {
    static constexpr Field ciphering = u8(13);
    static constexpr std::size_t minimumLength = 19;
    static_assert(ciphering.end() <= minimumLength);
};

} // namespace pelorus
