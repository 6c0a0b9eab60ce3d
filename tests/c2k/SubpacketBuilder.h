#pragma once

#include "tests/support/PacketBuilder.h"

namespace pelorus::test {

/// A packet of subpackets, the first of which starts at byte 17; their number stands at 14.
class SubpacketBuilder {
public:
    /// A subpacket by its own offsets, header included; its size is its length.
    SubpacketBuilder& add(unsigned identifier, PacketBuilder content)
    {
        const auto length = static_cast<unsigned>(content.bytes().size());
        return addSized(identifier, length, std::move(content));
    }
    /// One that says that it has `size` bytes.
    SubpacketBuilder& addSized(unsigned identifier, unsigned size, PacketBuilder content)
    {
        content.u8(0, identifier).u16(2, size);
        packet.u8(14, ++count).raw(content.bytes());
        return *this;
    }
    SubpacketBuilder& claim(unsigned subpackets)
    {
        packet.u8(14, subpackets);
        return *this;
    }
    PacketBuilder& bytes() { return packet; }

private:
    PacketBuilder packet{17};
    unsigned count = 0;
};

} // namespace pelorus::test
