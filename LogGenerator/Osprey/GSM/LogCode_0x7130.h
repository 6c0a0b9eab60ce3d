#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// State of packet-switched mobility management.
struct LogCode_0x7130 {
    static constexpr Field state = u8(13);
    static constexpr Field subState = u8(14);
    static constexpr Field updateStatus = u8(15);
    static constexpr std::size_t minimumLength = 16;
    static_assert(updateStatus.end() == minimumLength);
};

} // namespace pelorus
