#pragma once

#include "LogGenerator/Osprey/ArrayOutOfBoundsException.h"
#include "LogGenerator/Osprey/Field.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstring>
#include <span>
#include <stdexcept>

namespace pelorus {

/// A packet's bytes, or one record's, not owned. Of a packet byte 0 is the log type, bytes 1 to 12 are the
/// header (length, log code at 3, time stamp), the payload begins at 13. Reads cannot leave the bytes.
class PacketView {
public:
    constexpr PacketView() = default;
    constexpr explicit PacketView(std::span<const std::byte> content) : bytes(content) {}

    constexpr std::size_t size() const { return bytes.size(); }
    constexpr bool covers(std::size_t length) const { return bytes.size() >= length; }
    constexpr std::span<const std::byte> from(std::size_t offset) const
    {
        return bytes.subspan(std::min(offset, bytes.size()));
    }

    /// The field's value. Throws std::out_of_range when it is not wholly inside, so ask covers() first.
    std::int64_t operator[](Field field) const
    {
        if (std::size_t{field.byte} + sizeof(std::uint64_t) <= bytes.size()) [[likely]]
            return extract(field, loadWord(bytes.data() + field.byte));
        if (!covers(field.end())) [[unlikely]]
            throw std::out_of_range("field beyond the packet");
        return extract(field, loadBytes(bytes.data() + field.byte, field.end() - field.byte));
    }

    /// The field's value where bytes beyond the end read as 0.
    std::int64_t padded(Field field) const
    {
        if (covers(field.end()))
            return (*this)[field];
        const auto rest = from(field.byte);
        return extract(field, loadBytes(rest.data(), rest.size()));
    }

    /// Record `index` of `count`. Throws ArrayOutOfBoundsException unless index < count and the record lies
    /// wholly inside.
    PacketView record(Records records, std::size_t index, std::size_t count) const
    {
        const std::size_t start = records.start + index * records.stride;
        if (index >= count || !covers(start + records.length)) [[unlikely]]
            throw ArrayOutOfBoundsException();
        return PacketView(bytes.subspan(start, records.length));
    }

    /// As record(), for records whose fields reach beyond them: `Length` bytes from the record's start, those
    /// beyond the packet being 0.
    template <std::size_t Length>
    std::array<std::byte, Length> recordAndBeyond(Records records, std::size_t index, std::size_t count) const
    {
        record(records, index, count);
        const auto reach = from(records.start + index * records.stride);
        std::array<std::byte, Length> copy{};
        std::copy_n(reach.begin(), std::min(Length, reach.size()), copy.begin());
        return copy;
    }

    /// How many of `count` records, from the first on, lie wholly inside.
    std::size_t wholeRecords(Records records, std::size_t count) const
    {
        if (!covers(records.start + records.length))
            return 0;
        return std::min(count, (bytes.size() - records.start - records.length) / records.stride + 1);
    }

private:
    // No field reaches beyond the eight bytes from its first on.
    static std::uint64_t loadWord(const std::byte* place)
    {
        std::uint64_t word = 0;
        std::memcpy(&word, place, sizeof word);
        if constexpr (std::endian::native == std::endian::big)
            word = __builtin_bswap64(word);
        return word;
    }

    static std::uint64_t loadBytes(const std::byte* place, std::size_t count)
    {
        std::uint64_t word = 0;
        for (std::size_t index = 0; index < count; ++index)
            word |= std::to_integer<std::uint64_t>(place[index]) << (8 * index);
        return word;
    }

    static std::int64_t extract(Field field, std::uint64_t word)
    {
        const std::uint64_t value = (word >> field.firstBit) & ((std::uint64_t{1} << field.bitCount) - 1);
        const std::uint64_t sign = field.isSigned ? std::uint64_t{1} << (field.bitCount - 1) : 0;
        return static_cast<std::int64_t>((value ^ sign) - sign);
    }

    std::span<const std::byte> bytes;
};

} // namespace pelorus
