#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// The UMTS cell that the handset camps on.
struct LogCode_0x4127 {
    static constexpr Field uplinkUarfcn = u32(13);
    static constexpr Field downlinkUarfcn = u32(17);
    static constexpr Field cellIdentity = u32(21);
    static constexpr Field registrationArea = u16(25); // URA identity
    static constexpr std::size_t minimumLength = 29;
    static_assert(registrationArea.end() <= minimumLength);
};

} // namespace pelorus
