#pragma once

#include "LogGenerator/C2K/SubpacketLayout.h"

namespace pelorus {

/// 1x state, radio and active set, in subpackets whose fields count from their first byte.
struct LogCode_0x119C : SubpacketLayout {
    struct SystemState {
        static constexpr unsigned identifier = 1;
        static constexpr Field deviceState = u8(4);
    };
    struct Radio {
        static constexpr unsigned identifier = 2;
        static constexpr Field bandClass0 = u8(4);
        static constexpr Field bandClass1 = u8(5);
        static constexpr Field channel0 = u16(6);
        static constexpr Field channel1 = u16(8);
        static constexpr Field receiveLevel0 = s8(10);  // 0.334 dBm, from -63.248 dBm
        static constexpr Field receiveLevel1 = s8(11);  // likewise
        static constexpr Field transmitLevel = s16(12); // 0.1 dBm
    };
    struct ActiveSet {
        static constexpr unsigned identifier = 3;
        // What the strength of a pilot is computed with, see activeSetStrength().
        static constexpr Field a = u16(4);
        static constexpr Field b = u8(6);
        static constexpr Field c = u8(7);
        static constexpr Field pilotCount = u8(8);
        static constexpr Field k = u8(9); // makes the records of the pilots longer
        static constexpr Field referencePn = u16(10);

        static constexpr std::size_t length = 12;
        static_assert(referencePn.end() == length);

        static constexpr Records pilots(std::size_t k)
        {
            return {.start = length, .stride = (6 * k + 15) & 0xFFC};
        }
        static constexpr Field pn = u16(0);
        /// With a k of 0 it stands in the record that follows: meant.
        static constexpr Field energy(std::uint32_t k) { return u16(12 + 4 * k); }
    };
    struct Fingers {
        static constexpr unsigned identifier = 4;
    };
};

} // namespace pelorus
