#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Idle-mode measurement of the neighbours on one frequency.
struct LogCode_0xB180 {
    static constexpr Field version = u8(13);
    static constexpr Field earfcn = u16(17);
    static constexpr Field qrxlevmin = bits(19, 0, 6); // 2 dB above -140 dBm
    static constexpr Field cellsLessOne = bits(19, 6, 5);
    static constexpr std::size_t minimumLength = 21;
    static_assert(cellsLessOne.end() == minimumLength);

    static constexpr Records cells{.start = minimumLength, .stride = 20};
    struct Cell {
        static constexpr Field physicalCellIdentity = bits(0, 0, 9);
        static constexpr Field measuredRssi = bits(0, 9, 8); // half dB above -140 dBm
        static constexpr Field measuredRsrp = bits(0, 17, 9);
        static constexpr Field averageRsrp = bits(0, 32, 9);
        static constexpr Field measuredRsrq = bits(0, 41, 7); // quarter dB above -30 dB
        static constexpr Field averageRsrq = bits(0, 48, 7);
        static constexpr Field srxlev = bits(0, 55, 7); // dB above -30 dB
        static constexpr Field frequencyOffset = u16(8);
        static constexpr Field frameOffset = bits(0, 96, 11);
        static constexpr Field sampleOffset = bits(0, 107, 19);
    };
};

} // namespace pelorus
