#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Packet system information that the cell supports.
struct LogCode_0x51FD {
    static constexpr Field psiStatus = u8(13);
    static constexpr Field countLR = u8(14);
    static constexpr Field countHR = u8(15);
    static constexpr Field extendedMeasurementOrder = u8(16);
    static constexpr Field siStatus = u8(33);
    static constexpr std::size_t minimumLength = 35;
    static_assert(siStatus.end() <= minimumLength);
};

} // namespace pelorus
