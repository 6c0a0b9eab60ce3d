#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// State of the GSM radio-resource layer.
struct LogCode_0x512C {
    static constexpr Field state = u8(13);
    static constexpr Field subState = u8(14);
    static constexpr Field status = u8(15);
    static constexpr Field dataMode = u8(16); // 0 is voice
    static constexpr std::size_t minimumLength = 17;
    static_assert(dataMode.end() == minimumLength);
};

} // namespace pelorus
