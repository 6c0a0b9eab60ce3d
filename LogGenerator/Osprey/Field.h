#pragma once

#include <cstddef>
#include <cstdint>

namespace pelorus {

/// Where one integer or bit field stands in a log packet (or in one of its records): plain data. Fields are
/// little-endian, may start at any byte, and are at most 32 bits wide.
struct Field {
    std::uint32_t byte = 0;
    std::uint8_t firstBit = 0; // 0 is the least significant bit of `byte`
    std::uint8_t bitCount = 8;
    bool isSigned = false;

    /// One past the last byte that the field touches.
    constexpr std::size_t end() const { return byte + (firstBit + bitCount + 7U) / 8; }
};
static_assert(sizeof(Field) == sizeof(std::uint64_t), "a field travels in one register");

constexpr Field u8(std::uint32_t byte)
{
    return {byte, 0, 8, false};
}
constexpr Field u16(std::uint32_t byte)
{
    return {byte, 0, 16, false};
}
constexpr Field u32(std::uint32_t byte)
{
    return {byte, 0, 32, false};
}
constexpr Field s8(std::uint32_t byte)
{
    return {byte, 0, 8, true};
}
constexpr Field s16(std::uint32_t byte)
{
    return {byte, 0, 16, true};
}
constexpr Field s32(std::uint32_t byte)
{
    return {byte, 0, 32, true};
}

/// `count` bits from bit `first` of the little-endian bit string that starts at `byte`.
constexpr Field bits(std::uint32_t byte, std::uint32_t first, std::uint8_t count)
{
    return {byte + first / 8, static_cast<std::uint8_t>(first % 8), count, false};
}

/// Where a list of equal records stands: record i begins at start + i * stride and is `length` bytes long.
struct Records {
    std::size_t start = 0;
    std::size_t stride = 0;
    std::size_t length = stride;
};

} // namespace pelorus
