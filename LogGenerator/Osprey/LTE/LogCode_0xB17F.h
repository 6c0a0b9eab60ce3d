#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Idle-mode measurement of the serving cell and the reselection parameters it broadcasts. From byte 19 on
/// the fields stand in one bit string.
struct LogCode_0xB17F {
    static constexpr Field version = u8(13);
    static constexpr Field earfcn = u16(17);
    static constexpr Field physicalCellIdentity = bits(19, 0, 9);
    static constexpr Field servingLayerPriority = bits(19, 9, 4);
    static constexpr Field measuredRsrp = bits(19, 16, 9); // quarter dB above -140 dBm
    static constexpr Field averageRsrp = bits(19, 25, 9);
    static constexpr Field measuredRsrq = bits(19, 34, 7); // quarter dB above -30 dB
    static constexpr Field averageRsrq = bits(19, 41, 7);
    static constexpr Field measuredRssi = bits(19, 48, 9); // half dB above -140 dBm
    static constexpr Field qrxlevmin = bits(19, 57, 6);    // 2 dB above -140 dBm
    static constexpr Field maximumPower = bits(19, 63, 7); // dB above -30 dBm; 64 not present
    static constexpr Field maximumTransmitPower = bits(19, 70, 6);
    static constexpr Field srxlev = bits(19, 80, 7); // dB above -30 dB
    static constexpr Field weakDrxCycles = bits(19, 87, 6);
    static constexpr Field sIntraSearch = bits(19, 93, 6);    // 2 dB; 32 not present
    static constexpr Field sNonIntraSearch = bits(19, 99, 6); // 2 dB; 32 not present
    static constexpr Field measurementRulesUpdated = bits(19, 105, 1);
    static constexpr Field measurementRules = bits(19, 106, 4);
    static constexpr std::size_t minimumLength = 33;
    static_assert(measurementRules.end() == minimumLength);
};

} // namespace pelorus
