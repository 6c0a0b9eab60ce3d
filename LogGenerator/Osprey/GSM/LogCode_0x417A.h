#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// The UMTS cells that the searcher follows: all cell entries, then as many measurement entries.
struct LogCode_0x417A {
    static constexpr Field receivedPower = s16(13); // of all cells together; tenths of a dB above -54.8 dBm
    static constexpr Field cellCount = u8(15);
    static constexpr std::size_t minimumLength = 16;
    static_assert(cellCount.end() == minimumLength);

    static constexpr Records cells{.start = minimumLength, .stride = 15};
    struct Cell {
        static constexpr Field scramblingCode = bits(7, 0, 13);
        static constexpr Field set = bits(8, 5, 3); // 0 is the active set
    };

    static constexpr std::size_t measurementLength = 44;
    static constexpr Records measurements(std::size_t cellCount)
    {
        return {.start = cells.start + cells.stride * cellCount, .stride = measurementLength};
    }
    struct Measurement {
        static constexpr Field ecio[] = {u32(32), u32(36), u32(40)}; // linear; the first that is not 0 counts
        static_assert(ecio[2].end() == measurementLength);
    };
};

} // namespace pelorus
