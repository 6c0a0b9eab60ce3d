#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// Idle-mode reselection candidates. The records are 4 bytes apart while their technology-specific fields
/// reach up to byte 11, into the records that follow: meant.
struct LogCode_0xB186 {
    static constexpr Field version = u8(13);
    static constexpr Field servingEarfcn = u16(15);
    static constexpr Field servingCellIdentity = u16(17);
    static constexpr Field candidateCount = u16(19);
    static constexpr std::size_t minimumLength = 21;
    static_assert(candidateCount.end() == minimumLength);

    static constexpr Records candidates{.start = minimumLength, .stride = 4};
    struct Candidate {
        static constexpr Field priority = u16(0);
        static constexpr Field technology = u16(2);
        static constexpr Field earfcn = u16(4);         // LTE
        static constexpr Field cellIdentity{6, 7, 9};   // LTE
        static constexpr Field uarfcn = u16(4);         // UTRAN
        static constexpr Field scramblingCode = u16(6); // UTRAN
        static constexpr Field arfcn = u16(4);          // GERAN
        static constexpr Field band = u8(6);            // GERAN
        static constexpr Field stationIdentity = u8(7); // GERAN, the BSIC
        static constexpr Field bandClass = u8(4);       // CDMA
        static constexpr Field channel = u16(8);        // CDMA
        static constexpr Field pilot = u16(10);         // CDMA
        static constexpr std::size_t reach = pilot.end();
    };
};

} // namespace pelorus
