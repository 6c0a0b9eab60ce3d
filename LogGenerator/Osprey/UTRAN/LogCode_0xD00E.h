#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Measured GSM neighbours.
struct LogCode_0xD00E {
    static constexpr Field cellCount = u8(16);
    static constexpr std::size_t minimumLength = 17;
    static_assert(cellCount.end() == minimumLength);

    static constexpr Records cells{.start = minimumLength, .stride = 8};
    struct Cell {
        static constexpr Field cellIdentity = bits(0, 0, 14);
        static constexpr Field bandIndicator = bits(1, 6, 1);
        static constexpr Field bsicValid = bits(1, 7, 1);
        static constexpr Field networkColourCode = u8(2);
        static constexpr Field stationColourCode = u8(3);
        static constexpr Field arfcn = u16(4);
        static constexpr Field rssi = s16(6);
        static_assert(rssi.end() == cells.stride);
    };
};

} // namespace pelorus
