#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// GPRS options of the cell: timers and access bursts.
struct LogCode_0x51F6 {
    static constexpr Field t3192 = u8(15);
    static constexpr Field drxTimerMaximum = u8(16);  // seconds
    static constexpr Field longAccessBursts = u8(17); // not 0: 11 bits instead of 8
    static constexpr std::size_t minimumLength = 24;
    static_assert(longAccessBursts.end() <= minimumLength);
};

} // namespace pelorus
