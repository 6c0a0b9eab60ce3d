#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Measurement of the GSM serving cell and its neighbours. In idle mode the words at 16 and 20 are C1 and C2,
/// in dedicated mode the receive qualities.
struct LogCode_0x5137 {
    static constexpr Field receiveLevel = u8(15);
    static constexpr Field c1 = u16(16); // the low half of the word
    static constexpr Field receiveQualityFull = u32(16);
    static constexpr Field c2 = u16(20); // likewise
    static constexpr Field receiveQualitySub = u32(20);
    static constexpr Field reselectHysteresis = u8(26);
    static constexpr Field neighbourCount = u8(28);
    static constexpr std::size_t minimumLength = 29;
    static_assert(neighbourCount.end() == minimumLength);

    static constexpr Records neighbours{.start = minimumLength, .stride = 14};
    struct Neighbour {
        static constexpr Field arfcn = u16(0);
        static constexpr Field receiveLevel = u8(2);
        static constexpr Field c1 = s32(3);
        static_assert(c1.end() <= neighbours.length);
    };
};

} // namespace pelorus
