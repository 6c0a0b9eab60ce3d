#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Master information block of the serving cell.
struct LogCode_0xB0C1 {
    static constexpr Field physicalCellIdentity = u16(14);
    static constexpr Field earfcn = u16(16);
    static constexpr Field transmitAntennas = u8(20);
    static constexpr std::size_t minimumLength = 22;
};

} // namespace pelorus
