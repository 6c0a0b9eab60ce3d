#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Whether discontinuous transmission is used.
struct LogCode_0x5072 {
    static constexpr Field discontinuousTransmission = u8(19);
    static constexpr std::size_t minimumLength = 20;
    static_assert(discontinuousTransmission.end() == minimumLength);
};

} // namespace pelorus
