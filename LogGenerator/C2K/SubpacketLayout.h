#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Packets of some 1x log codes are a list of subpackets, of which each says what it is and how long.
struct SubpacketLayout {
    static constexpr Field count = u8(14);   // of the packet
    static constexpr std::size_t start = 17; // of the first one
    static constexpr std::size_t minimumLength = 17;

    // Of a subpacket.
    static constexpr Field identifier = u8(0);
    static constexpr Field size = u16(2); // header included
};

} // namespace pelorus
