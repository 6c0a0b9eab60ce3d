#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// EV-DO fingers of the receiver and the carrier-to-interference ratio of each.
struct LogCode_0x108A {
    static constexpr Field fingerCount = u8(22);
    static constexpr std::size_t minimumLength = 23; // and exactly that with all fingers
    static_assert(fingerCount.end() == minimumLength);

    static constexpr Records fingers{.start = minimumLength, .stride = 14};
    struct Finger {
        static constexpr Field pn = u16(0);       // 0xFFFF for a finger that is assigned to none
        static constexpr Field strength = u16(6); // C/I in 1/512
        static_assert(strength.end() <= fingers.length);
    };
};

} // namespace pelorus
