#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// The base-station identities that were decoded on the neighbours' channels.
struct LogCode_0x51FF {
    static constexpr Field entryCount = u8(14);
    static constexpr std::size_t minimumLength = 15;
    static_assert(entryCount.end() == minimumLength);

    static constexpr Records entries{.start = minimumLength, .stride = 4};
    struct Entry {
        static constexpr Field arfcn = u16(0);
        static constexpr Field bsic = u8(2);
        static_assert(bsic.end() <= entries.length);
    };
};

} // namespace pelorus
