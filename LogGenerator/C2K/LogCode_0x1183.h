#pragma once

#include "LogGenerator/Osprey/Field.h"

namespace pelorus {

/// EV-DO air-link summary: the serving sector, signal levels and the session.
struct LogCode_0x1183 {
    static constexpr Field channel = bits(13, 0, 11);
    static constexpr Field bandClass = bits(14, 3, 5);
    static constexpr Field receiveLevel0 = s8(15); // dBm
    static constexpr Field receiveLevel1 = s8(16); // dBm
    static constexpr Field transmitLevel = s8(17); // dBm
    static constexpr Field servingPilot = u16(18); // PN offset in units of 64 chips, 0xFFFF for none
    static constexpr Field deviceState = u8(36);
    static constexpr Field sessionState = u8(37);
    static constexpr Field accessTerminal = bits(38, 0, 24); // UATI24
    static constexpr Field colorCode = u8(41);
    static constexpr std::size_t length = 50; // exactly
    static_assert(channel.end() == 15 && bandClass.end() == 15 && accessTerminal.end() == colorCode.byte);
    static_assert(colorCode.end() <= length);
};

} // namespace pelorus
