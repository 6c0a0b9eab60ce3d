#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// The network and area that the handset is registered in. The identity's digits are nibbles in the order of
/// 3GPP TS 24.008, 10.5.1.3; 10 and above are fillers.
struct LogCode_0x7135 {
    static constexpr Field networkOperatingMode = u8(13);
    static constexpr Field serviceType = u8(14);
    static constexpr Field countryCode[] = {bits(15, 0, 4), bits(15, 4, 4), bits(16, 0, 4)};
    static constexpr Field networkCode[] = {bits(17, 0, 4), bits(17, 4, 4), bits(16, 4, 4)};
    static constexpr Field locationAreaHigh = u8(18); // the area code stands big-endian
    static constexpr Field locationAreaLow = u8(19);
    static constexpr Field routingArea = u8(20);
    static constexpr std::size_t minimumLength = 32;
    static_assert(routingArea.end() <= minimumLength);
};

} // namespace pelorus
