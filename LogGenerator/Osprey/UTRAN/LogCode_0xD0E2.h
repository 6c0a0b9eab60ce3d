#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Identity and frequencies of the serving UTRAN cell.
struct LogCode_0xD0E2 {
    static constexpr Field accessRestrictions = u8(14);
    static constexpr Field uraIdentity = u8(15);
    static constexpr Field uplinkUarfcn = u16(17);
    static constexpr Field downlinkUarfcn = u16(19);
    static constexpr Field cellIdentity = u32(21);
    static constexpr Field emergencyCallsOnly = bits(25, 0, 1);
    static constexpr std::size_t minimumLength = 26;
    static_assert(emergencyCallsOnly.end() == minimumLength);
};

} // namespace pelorus
