#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// EV-DO pilots of the active set.
struct LogCode_0x12B6 {
    static constexpr Field pilotCount = u8(15);
    static constexpr std::size_t minimumLength = 25;

    static constexpr Records pilots{.start = minimumLength, .stride = 12};
    struct Pilot {
        static constexpr Field pn = u16(0);
        static constexpr Field strength = u16(2); // energy in 1/512
        static_assert(strength.end() <= pilots.length);
    };
};

} // namespace pelorus
