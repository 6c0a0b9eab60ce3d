#include "platform/linux/Frame.h"

#include <bit>
#include <cstring>
#include <fmt/format.h>

namespace pelorus {

namespace {

constexpr std::uint32_t littleEndian(std::uint32_t value)
{
    return std::endian::native == std::endian::little ? value : __builtin_bswap32(value);
}

void put(std::byte* at, std::uint32_t value)
{
    value = littleEndian(value);
    std::memcpy(at, &value, sizeof value);
}

std::uint32_t get(const std::byte* at)
{
    std::uint32_t value = 0;
    std::memcpy(&value, at, sizeof value);
    return littleEndian(value);
}

} // namespace

std::array<std::byte, FrameHeader::size> FrameHeader::pack(const Frame& frame)
{
    std::array<std::byte, size> bytes;
    put(&bytes[0], frame.hasData ? static_cast<std::uint32_t>(frame.payload.size()) : noData);
    put(&bytes[4], static_cast<std::uint32_t>(frame.id));
    put(&bytes[8], static_cast<std::uint32_t>(frame.kind));
    put(&bytes[12], frame.sequence);
    return bytes;
}

bool FrameHeader::parse(std::span<const std::byte, size> bytes, std::string& why)
{
    const std::uint32_t length = get(&bytes[0]);
    const std::uint32_t kind = get(&bytes[8]);
    if (kind > static_cast<std::uint32_t>(FrameKind::reply)) {
        why = fmt::format("frame of unknown kind {}", kind);
        return false;
    }
    frame = {.id = static_cast<std::int32_t>(get(&bytes[4])),
             .kind = static_cast<FrameKind>(kind),
             .sequence = get(&bytes[12]),
             .payload = {},
             .hasData = true};
    if (length == noData && frame.kind == FrameKind::reply) {
        frame.hasData = false;
        payloadLength = 0;
        return true;
    }
    if (length > maximumPayload) {
        why = fmt::format("frame of {} bytes announced, at most {} are allowed", length, maximumPayload);
        return false;
    }
    payloadLength = length;
    return true;
}

} // namespace pelorus
