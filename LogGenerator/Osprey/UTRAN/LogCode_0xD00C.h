#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Block error rates of the transport channels, and signal-to-interference values of the coded composite
/// transport channels (CCTrCH). The latter begin 34 bytes further for every transport channel, although a
/// transport channel's record has 2 bytes: meant.
struct LogCode_0xD00C {
    static constexpr Field transportChannelCount = bits(14, 6, 6);
    static constexpr Field compositeChannelCount = bits(14, 12, 4);
    static constexpr std::size_t minimumLength = 17;

    static constexpr Records transportChannels{.start = minimumLength, .stride = 2};
    struct TransportChannel {
        static constexpr Field identity = u8(0);
        static constexpr Field blockErrorRate = u8(1);
    };

    static constexpr Records compositeChannels(std::size_t transportChannels)
    {
        return {.start = 289 + 34 * transportChannels, .stride = 8};
    }
    struct CompositeChannel {
        static constexpr Field identity = u8(0);
        static constexpr Field timeslot = u8(1);
        static constexpr Records sirValues{.start = 2, .stride = 1};
        static constexpr std::size_t sirCount = 6; // one a timeslot position
        static constexpr Field sir = u8(0);        // within its own byte
    };
};

} // namespace pelorus
