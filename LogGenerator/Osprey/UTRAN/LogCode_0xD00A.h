#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Measured UTRAN neighbours. The records stand far behind the count; of their 16 bytes only the first 4 are
/// known.
struct LogCode_0xD00A {
    static constexpr Field cellCount = bits(16, 1, 7);
    static constexpr std::size_t minimumLength = 21;

    static constexpr Records cells{.start = 168, .stride = 16};
    struct Cell {
        static constexpr Field uarfcn = bits(0, 0, 14);
        static constexpr Field cellIdentity = bits(0, 14, 7);
        static constexpr Field filteredRscp = bits(0, 21, 8); // 1/256
        static constexpr Field setMembership = bits(0, 29, 2);
        static constexpr Field inJdcsList = bits(0, 31, 1);
    };
};

} // namespace pelorus
