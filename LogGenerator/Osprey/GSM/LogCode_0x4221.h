#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// HARQ statistics of HSDPA. The secondary list begins 162 bytes further on for each primary entry although
/// an entry is 9 bytes long: meant.
struct LogCode_0x4221 {
    static constexpr Field version = u8(13);
    static constexpr Field subFrameCount = bits(14, 0, 10);
    static constexpr Field carriers = bits(14, 10, 2);
    static constexpr Field primaryCount = u8(16);
    static constexpr Field secondaryCount = u8(17);
    static constexpr std::size_t minimumLength = 18;
    static_assert(secondaryCount.end() == minimumLength);

    static constexpr Records primaryProcesses{.start = minimumLength, .stride = 9};
    static constexpr Records secondaryProcesses(std::size_t primaryCount)
    {
        return {.start = minimumLength + 162 * primaryCount, .stride = 9};
    }
    struct Process {
        static constexpr Field identity = u8(0);
        static constexpr Field receivedBits = u32(1);
        static constexpr Field newTransmissions = u16(5);
        static constexpr Field blockErrors = u16(7);
        static_assert(blockErrors.end() == primaryProcesses.length);
    };
};

} // namespace pelorus
