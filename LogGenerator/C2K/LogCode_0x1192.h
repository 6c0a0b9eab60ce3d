#pragma once

#include "LogGenerator/Osprey/Field.h"

#include <array>

namespace pelorus {

/// EV-DO forward-link packets: how many of each kind were received since the start.
struct LogCode_0x1192 {
    static constexpr Field sequenceNumber = u32(13);

    /// One counter of 32 bits in each record.
    static constexpr Records counters{.start = 17, .stride = 4};
    static constexpr std::size_t countersPerRecord = 1;
    static constexpr std::size_t recordCount = 56;
    /// What one packet of each kind carries; 0 for those that carry nothing of their own.
    static constexpr std::array<std::int32_t, 56> weights{
        128,  256,  512, 1024, 0,    128,  256,  512,  1024, 0,    128,  256,  512,  1024,
        0,    128,  256, 512,  1024, 0,    128,  256,  512,  1024, 0,    512,  1024, 2048,
        0,    128,  256, 512,  1024, 0,    512,  1024, 2048, 0,    1024, 3072, 0,    512,
        1024, 2048, 0,   4096, 0,    1024, 3072, 0,    4096, 0,    5120, 0,    5120, 0};

    static constexpr std::size_t minimumLength = 241;
    static_assert(counters.start == sequenceNumber.end());
    static_assert(counters.start + recordCount * counters.stride == minimumLength);
};

} // namespace pelorus
