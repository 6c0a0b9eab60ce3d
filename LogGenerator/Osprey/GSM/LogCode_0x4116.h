#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Block errors of the transport channels.
struct LogCode_0x4116 {
    static constexpr Field channelCount = u8(13);
    static constexpr Field windowSize = u16(14);
    static constexpr std::size_t minimumLength = 16;
    static_assert(windowSize.end() == minimumLength);

    static constexpr Records channels{.start = minimumLength, .stride = 9};
    struct Channel {
        static constexpr Field identity = u8(0);
        static constexpr Field received = u32(1); // CRCs
        static constexpr Field inError = u32(5);  // CRCs
        static_assert(inError.end() == channels.length);
    };
};

} // namespace pelorus
