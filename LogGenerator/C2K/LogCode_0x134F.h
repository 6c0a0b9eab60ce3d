#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Identity of the 1x system and the roaming indicator. The fields behind the minimum length are 0 in packets
/// that end before them.
struct LogCode_0x134F {
    static constexpr Field version = u8(13);
    static constexpr std::int64_t firstVersion = 2;
    static constexpr Field roamingIndicator = u32(42);
    static constexpr Field systemType = u32(46);
    static constexpr std::int64_t knownSystemType = 2; // whose identifiers are known
    static constexpr Field systemIdentifier = u16(50);
    static constexpr Field networkIdentifier = u16(52);
    static constexpr Field packetZone = u8(131);
    static constexpr Field protocolRevision = u8(133);
    static constexpr Field baseStation = u16(184);
    static constexpr std::size_t minimumLength = 171;
    static_assert(protocolRevision.end() <= minimumLength && baseStation.byte > minimumLength);
};

} // namespace pelorus
