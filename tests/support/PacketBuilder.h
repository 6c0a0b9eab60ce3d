#pragma once

#include "platform/PropertyList.h"
#include "platform/Value.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace pelorus::test {

/// Builds a log packet by offset: what is not written is 0. Byte 0 is the log type.
class PacketBuilder {
public:
    explicit PacketBuilder(std::size_t length = 0) : content(length) {}

    PacketBuilder& u8(std::size_t offset, unsigned value) { return put(offset, 1, value); }
    PacketBuilder& u16(std::size_t offset, unsigned value) { return put(offset, 2, value); }
    PacketBuilder& u32(std::size_t offset, std::uint64_t value) { return put(offset, 4, value); }
    PacketBuilder& s8(std::size_t offset, int value) { return put(offset, 1, static_cast<unsigned>(value)); }
    PacketBuilder& s16(std::size_t offset, int value) { return put(offset, 2, static_cast<unsigned>(value)); }
    PacketBuilder& s32(std::size_t offset, std::int64_t value)
    {
        return put(offset, 4, static_cast<std::uint64_t>(value));
    }
    /// ORs `count` bits of `value` in, from bit `first` of the bit string that starts at `offset`.
    PacketBuilder& bits(std::size_t offset, unsigned first, unsigned count, std::uint64_t value)
    {
        for (unsigned bit = 0; bit < count; ++bit) {
            const std::size_t place = offset + (first + bit) / 8;
            reach(place + 1);
            if (value >> bit & 1)
                content[place] |= std::byte{1} << ((first + bit) % 8);
        }
        return *this;
    }
    /// Appends a property list, binary as telephony servers send it.
    PacketBuilder& list(const Value& value)
    {
        const auto bytes = serializePropertyList(value, PropertyListForm::binary);
        return raw(bytes.value());
    }
    PacketBuilder& raw(const std::vector<std::byte>& bytes)
    {
        content.insert(content.end(), bytes.begin(), bytes.end());
        return *this;
    }
    PacketBuilder& length(std::size_t bytes)
    {
        content.resize(bytes);
        return *this;
    }

    const std::vector<std::byte>& bytes() const { return content; }

private:
    PacketBuilder& put(std::size_t offset, std::size_t width, std::uint64_t value)
    {
        reach(offset + width);
        for (std::size_t place = 0; place < width; ++place)
            content[offset + place] = static_cast<std::byte>(value >> (8 * place));
        return *this;
    }
    void reach(std::size_t end)
    {
        if (content.size() < end)
            content.resize(end);
    }

    std::vector<std::byte> content;
};

/// A packet of the telephony server itself: log type 0xFF, then the list behind the 13-byte header.
inline PacketBuilder internalPacket(const Value& list)
{
    return PacketBuilder(13).u8(0, 0xFF).list(list);
}

} // namespace pelorus::test
