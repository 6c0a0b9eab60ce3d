#pragma once

#include "LogGenerator/Osprey/Field.h"

#include <array>

namespace pelorus {

/// EV-DO reverse-link packets: how many of each payload size were sent since the start.
struct LogCode_0x127E {
    static constexpr Field sequenceNumber = u32(14); // one byte later than on the forward link: meant

    /// Four counters of 32 bits at the start of each record, a record for each payload size; the sizes go
    /// round six times.
    static constexpr Records counters{.start = 18, .stride = 24};
    static constexpr std::size_t countersPerRecord = 4;
    static constexpr std::size_t recordCount = 72;
    static constexpr std::array<std::int32_t, 12> weights{128,  256,  512,  768,  1024, 1536,
                                                          2048, 3072, 4096, 6144, 8192, 12288};

    static constexpr std::size_t minimumLength = 1750;
    static_assert(counters.start == sequenceNumber.end() && recordCount % weights.size() == 0);
    static_assert(counters.start + recordCount * counters.stride <= minimumLength);
};

} // namespace pelorus
