#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// The networks that count as the serving one. An entry is read six bytes long while the entries stand three
/// bytes apart, and the digits of its two codes take turns: meant.
struct LogCode_0x7150 {
    static constexpr Field networkCount = u8(16);
    static constexpr std::size_t minimumLength = 17;
    static_assert(networkCount.end() == minimumLength);

    static constexpr Records networks{.start = minimumLength, .stride = 3, .length = 6};
    struct Network {
        static constexpr Field countryCode[] = {u8(0), u8(2), u8(4)}; // decimal digits
        static constexpr Field networkCode[] = {u8(1), u8(3), u8(5)};
        static_assert(networkCode[2].end() == networks.length);
    };
};

} // namespace pelorus
