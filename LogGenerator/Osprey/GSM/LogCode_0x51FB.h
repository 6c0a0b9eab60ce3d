#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Whether the cell has a packet broadcast channel.
struct LogCode_0x51FB {
    static constexpr Field present = u8(13);
    static constexpr std::size_t minimumLength = 34;
    static_assert(present.end() <= minimumLength);
};

} // namespace pelorus
