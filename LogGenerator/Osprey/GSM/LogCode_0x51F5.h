#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// GPRS options of the cell: access and control.
struct LogCode_0x51F5 {
    static constexpr Field packetFlowContexts = u8(13);
    static constexpr Field priorityAccessThreshold = u8(14);
    static constexpr Field networkControlOrder = u8(15);
    static constexpr std::size_t minimumLength = 18;
    static_assert(networkControlOrder.end() <= minimumLength);
};

} // namespace pelorus
