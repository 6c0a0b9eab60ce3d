#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// The channels of a hopping sequence.
struct LogCode_0x51F8 {
    static constexpr Field hoppingSequence = u8(13);
    static constexpr Field channelCount = u8(14);
    static constexpr std::size_t minimumLength = 15;
    static_assert(channelCount.end() == minimumLength);

    static constexpr Records channels{.start = minimumLength, .stride = 2};
    struct Channel {
        static constexpr Field arfcn = u16(0);
        static_assert(arfcn.end() == channels.length);
    };
};

} // namespace pelorus
