#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Samples of the transmit power.
struct LogCode_0x4031 {
    static constexpr Field sampleCount = u8(14);
    static constexpr std::size_t minimumLength = 16;
    static_assert(sampleCount.end() <= minimumLength);

    static constexpr Records samples{.start = minimumLength, .stride = 14};
    struct Sample {
        static constexpr Field power = s16(4); // tenths of a dB above -18.8 dBm; 0 is no sample
        static_assert(power.end() <= samples.length);
    };
};

} // namespace pelorus
