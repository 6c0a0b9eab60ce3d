#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Connected-mode intra-frequency measurement: the serving cell, then the measured neighbours, then the cells
/// that were only detected. RSRP in quarter dB above -140 dBm, RSRQ in eighth dB above -20 dB.
struct LogCode_0xB179 {
    static constexpr Field earfcn = u16(17);
    static constexpr Field servingCellIdentity = u16(19);
    static constexpr Field subframeNumber = u16(21);
    static constexpr Field servingRsrp = u16(23);
    static constexpr Field servingRsrq = u16(25);
    static constexpr Field measuredCount = u8(27);
    static constexpr Field detectedCount = u8(28);
    static constexpr std::size_t minimumLength = 29;
    static_assert(detectedCount.end() == minimumLength);

    struct MeasuredCell {
        static constexpr Field physicalCellIdentity = u16(0);
        static constexpr Field rsrp = u16(2);
        static constexpr Field rsrq = u16(4);
    };
    struct DetectedCell {
        static constexpr Field physicalCellIdentity = u16(0);
    };

    static constexpr Records measuredCells{.start = minimumLength, .stride = 6};
    static constexpr Records detectedCells(std::size_t measured)
    {
        return {.start = measuredCells.start + measuredCells.stride * measured, .stride = 2};
    }
};

} // namespace pelorus
