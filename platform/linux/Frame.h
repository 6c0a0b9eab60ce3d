#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <string>

namespace pelorus {

enum class FrameKind : std::uint32_t { oneWay = 0, request = 1, reply = 2 };

/// One message on a port's stream. The payload is not owned.
struct Frame {
    std::int32_t id = 0;
    FrameKind kind = FrameKind::oneWay;
    std::uint32_t sequence = 0; // a reply repeats its request's
    std::span<const std::byte> payload = {};
    bool hasData = true; // false only for a reply that carries none, which is not the same as an empty one
};

/// What precedes each payload: u32 payload length, i32 message id, u32 kind, u32 sequence, little-endian.
struct FrameHeader {
    static constexpr std::size_t size = 16;
    static constexpr std::uint32_t noData = 0xFFFFFFFF; // the length of a reply without data
    static constexpr std::size_t maximumPayload = 16 * 1024 * 1024;

    /// `frame.payload` is at most maximumPayload long.
    static std::array<std::byte, size> pack(const Frame& frame);

    /// False for a header that no honest peer sends; `why` then says so in one line.
    bool parse(std::span<const std::byte, size> bytes, std::string& why);

    Frame frame; // its payload is empty until the payload is there
    std::size_t payloadLength = 0;
};

} // namespace pelorus
