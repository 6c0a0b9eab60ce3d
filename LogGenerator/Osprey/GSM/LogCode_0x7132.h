#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// State of the registration with a network.
struct LogCode_0x7132 {
    static constexpr Field registrationState = u8(13);
    static constexpr Field selectionMode = u8(14); // of the PLMN
    static constexpr std::size_t minimumLength = 16;
    static_assert(selectionMode.end() <= minimumLength);
};

} // namespace pelorus
