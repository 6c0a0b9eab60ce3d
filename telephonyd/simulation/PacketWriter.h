#pragma once

#include "LogGenerator/Osprey/Field.h"

#include <algorithm>
#include <bit>
#include <cstring>
#include <vector>

namespace pelorus {

/// Writes the fields of one packet, or of one of its records, where their layout has them. A value that a
/// field cannot hold becomes the nearest one that it can.
class PacketWriter {
public:
    /// Fields are stored by whole words: the buffer goes on for this many bytes behind the packet.
    static constexpr std::size_t kSlack = 8;

    PacketWriter(std::vector<std::byte>& packets, std::size_t first) : buffer(packets), start(first) {}

    void put(Field field, std::int64_t value)
    {
        const std::int64_t limit = std::int64_t{1} << (field.bitCount - (field.isSigned ? 1 : 0));
        const std::int64_t fitting = std::clamp(value, field.isSigned ? -limit : 0, limit - 1);
        const std::uint64_t mask = ((std::uint64_t{1} << field.bitCount) - 1) << field.firstBit;
        std::byte* const place = buffer.data() + start + field.byte;
        std::uint64_t word = 0;
        std::memcpy(&word, place, sizeof word);
        word = littleEndian(word);
        word = (word & ~mask) | ((static_cast<std::uint64_t>(fitting) << field.firstBit) & mask);
        word = littleEndian(word);
        std::memcpy(place, &word, sizeof word);
    }

    /// Nothing checks the index: the packet was made long enough for its records.
    PacketWriter record(Records records, std::size_t index) const
    {
        return {buffer, start + records.start + index * records.stride};
    }

private:
    static std::uint64_t littleEndian(std::uint64_t word)
    {
        if constexpr (std::endian::native == std::endian::big)
            word = __builtin_bswap64(word);
        return word;
    }

    std::vector<std::byte>& buffer;
    std::size_t start;
};

} // namespace pelorus
