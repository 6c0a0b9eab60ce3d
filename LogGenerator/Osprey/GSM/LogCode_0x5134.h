#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// The GSM cell that the handset camps on.
struct LogCode_0x5134 {
    static constexpr Field arfcn = u16(13);
    static constexpr Field bsic = u16(15);
    static constexpr Field cellIdentity = u16(17);
    static constexpr std::size_t minimumLength = 26;
    static_assert(cellIdentity.end() <= minimumLength);
};

} // namespace pelorus
