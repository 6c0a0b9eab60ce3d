#pragma once

#include "LogGenerator/C2K/SubpacketLayout.h"

namespace pelorus {

/// 1x traffic channel, in subpackets.
struct LogCode_0x119D : SubpacketLayout {
    struct TrafficDemodulator {
        static constexpr unsigned identifier = 11;
        static constexpr Field frameError = u8(24); // not 0: the frame was lost
    };
};

} // namespace pelorus
