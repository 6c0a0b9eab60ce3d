#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Configuration of the serving cell. Bandwidths are in resource blocks.
struct LogCode_0xB0C2 {
    static constexpr Field physicalCellIdentity = u16(14);
    static constexpr Field downlinkEarfcn = u16(16);
    static constexpr Field uplinkEarfcn = u16(18);
    static constexpr Field downlinkBandwidth = u8(20);
    static constexpr Field uplinkBandwidth = u8(21);
    static constexpr Field cellIdentity = u32(22);
    static constexpr Field trackingAreaCode = u16(26);
    static constexpr Field bandIndicator = u32(28);
    static constexpr std::size_t minimumLength = 38;
};

} // namespace pelorus
