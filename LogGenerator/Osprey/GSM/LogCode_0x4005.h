#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Cells ranked for reselection. Both lists begin at the same byte, so a packet that carries cells of both
/// kinds shows the same bytes twice: meant.
struct LogCode_0x4005 {
    static constexpr Field umtsCellCount = u8(13);
    static constexpr Field gsmCellCount = u8(14);
    static constexpr std::size_t minimumLength = 15;
    static_assert(gsmCellCount.end() == minimumLength);

    static constexpr Records umtsCells{.start = minimumLength, .stride = 10};
    struct UMTSCell {
        static constexpr Field downlinkUarfcn = s16(0); // shown as signed: meant
        static constexpr Field scramblingCode = u16(2);
        static constexpr Field rscp = s8(4); // dB above -21 dB
        static constexpr Field rankRscp = s16(5);
        static constexpr Field ecno = s8(7); // half dB
        static constexpr Field rankingValue = s16(8);
        static_assert(rankingValue.end() == umtsCells.length);
    };

    static constexpr Records gsmCells{.start = minimumLength, .stride = 7};
    struct GSMCell {
        static constexpr Field arfcn = u16(0);
        static constexpr Field bsic = u16(2);
        static constexpr Field rssi = s8(4); // dBm
        static constexpr Field rankingValue = s16(5);
        static_assert(rankingValue.end() == gsmCells.length);
    };
};

} // namespace pelorus
