#pragma once

#include "LogGenerator/C2K/Lookup.h"
#include "LogGenerator/LogGenerator.h"

namespace pelorus {

// One decoder for each log code: it reads a packet without its prefix and publishes what that says. A packet
// that it cannot use is logged and changes nothing. Some keep a quantity in the state from packet to packet.

void decodeAirLinkSummary(PacketView data, State& state, const Lookup& lookup);     // 0x1183
void decodeActiveSetPilots(PacketView data, State& state, const Lookup& lookup);    // 0x12B6
void decodeFingers(PacketView data, State& state, const Lookup& lookup);            // 0x108A
void decodeForwardLinkPackets(PacketView data, State& state, const Lookup& lookup); // 0x1192
void decodeReverseLinkPackets(PacketView data, State& state, const Lookup& lookup); // 0x127E
void decodeOneXState(PacketView data, State& state, const Lookup& lookup);          // 0x119C
void decodeOneXTraffic(PacketView data, State& state, const Lookup& lookup);        // 0x119D
void decodeSystemIdentity(PacketView data, State& state, const Lookup& lookup);     // 0x134F

} // namespace pelorus
