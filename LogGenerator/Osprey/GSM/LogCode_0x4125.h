#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// State of the UMTS radio-resource control.
struct LogCode_0x4125 {
    static constexpr Field state = u8(13);
    static constexpr std::size_t minimumLength = 14;
    static_assert(state.end() == minimumLength);
};

} // namespace pelorus
