#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// The channel of dedicated mode.
struct LogCode_0x5076 {
    static constexpr Field dedicatedArfcn = u16(13);
    static constexpr Field dedicatedArfcnLow = u8(13); // its low 8 bits
    static constexpr std::size_t minimumLength = 17;
    static_assert(dedicatedArfcn.end() <= minimumLength);
};

} // namespace pelorus
