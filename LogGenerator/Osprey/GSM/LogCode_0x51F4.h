#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Where the cell sends system information 13.
struct LogCode_0x51F4 {
    static constexpr Field position = u8(14);
    static constexpr std::size_t minimumLength = 15;
    static_assert(position.end() == minimumLength);
};

} // namespace pelorus
