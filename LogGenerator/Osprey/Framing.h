#pragma once

#include "LogGenerator/Osprey/LogPacket.h"

namespace pelorus {

// The frame around a log packet: an optional prefix of 2 bytes, of which the first is 0x81, then the log type
// at 0 and the log code at 3, little-endian.

constexpr std::int64_t kBasebandPacket = 1;
constexpr std::int64_t kInternalPacket = 0xFF; // of the telephony server

/// The message without its prefix, if it has one; it is at least a packet header long.
inline std::span<const std::byte> withoutPrefix(std::span<const std::byte> message)
{
    constexpr std::int64_t kPrefixMark = 0x81;
    constexpr std::size_t kPrefixLength = 2;
    return PacketView(message)[u8(0)] == kPrefixMark ? message.subspan(kPrefixLength) : message;
}

inline std::int64_t logTypeOf(PacketView packet)
{
    return packet[u8(0)];
}

inline LogCode logCodeOf(PacketView packet)
{
    return static_cast<LogCode>(packet[u16(3)]) | (logTypeOf(packet) == kInternalPacket ? kInternalCodes : 0);
}

} // namespace pelorus
