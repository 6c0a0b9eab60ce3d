#pragma once

#include <cstddef>
#include <cstdint>
#include <span>

namespace pelorus::test {

/// Reads a packet by offsets that the test spells itself.
class PacketReader {
public:
    explicit PacketReader(std::span<const std::byte> packet) : bytes(packet) {}

    std::size_t size() const { return bytes.size(); }
    int u8(std::size_t offset) const { return bits(offset, 0, 8); }
    int u16(std::size_t offset) const { return bits(offset, 0, 16); }
    int u32(std::size_t offset) const { return bits(offset, 0, 31); }
    /// `count` bits from bit `first` of the little-endian bit string at `offset`.
    int bits(std::size_t offset, unsigned first, unsigned count) const
    {
        unsigned value = 0;
        for (unsigned bit = 0; bit < count; ++bit) {
            const std::size_t place = offset + (first + bit) / 8;
            const unsigned byte = std::to_integer<unsigned>(bytes[place]); // the sanitizers hold the bound
            value |= (byte >> ((first + bit) % 8) & 1U) << bit;
        }
        return static_cast<int>(value);
    }
    /// The code of the header, with the telephony server's own from 0xFF0000.
    int code() const { return u16(3) | (u8(0) == 0xFF ? 0xFF0000 : 0); }
    PacketReader from(std::size_t offset) const { return PacketReader(bytes.subspan(offset)); }
    std::span<const std::byte> payload() const { return bytes.subspan(13); }

private:
    std::span<const std::byte> bytes;
};

} // namespace pelorus::test
