#pragma once

#include "tests/recording/RecordingFixture.h"

namespace pelorus::test {

/// A pcap file, written by hand.
class PcapFile {
public:
    static constexpr std::uint32_t kMicroseconds = 0xA1B2C3D4;
    static constexpr std::uint32_t kNanoseconds = 0xA1B23C4D;

    explicit PcapFile(std::uint32_t magic, unsigned linkType = 147)
    {
        content.u32(magic).u16(2).u16(4).u32(0).u32(0).u32(262144).u32(linkType);
    }
    PcapFile& packet(std::uint32_t seconds, std::uint32_t fraction, const Bytes& bytes)
    {
        return cutPacket(seconds, fraction, bytes, bytes.size());
    }
    /// A packet that was longer than what was kept of it.
    PcapFile& cutPacket(std::uint32_t seconds, std::uint32_t fraction, const Bytes& bytes, std::size_t length)
    {
        content.u32(seconds).u32(fraction).u32(bytes.size()).u32(length).raw(bytes);
        return *this;
    }
    const Bytes& bytes() const { return content.bytes(); }

private:
    BytesBuilder content;
};

/// A pcapng file, written by hand: one section, one interface.
class PcapngFile {
public:
    explicit PcapngFile(unsigned linkType = 147, unsigned timeResolution = 6)
    {
        block(0x0A0D0D0A, BytesBuilder().u32(0x1A2B3C4D).u16(1).u16(0).u64(~std::uint64_t{0}).bytes());
        interface(linkType, timeResolution);
    }
    /// `timeResolution` is the negative power of 10 of the time unit.
    PcapngFile& interface(unsigned linkType, unsigned timeResolution = 6)
    {
        return block(1, BytesBuilder()
                            .u16(linkType)
                            .u16(0)
                            .u32(262144)
                            .u16(9)
                            .u16(1)
                            .u8(timeResolution)
                            .zeros(3)
                            .u32(0)
                            .bytes());
    }
    PcapngFile& packet(std::uint64_t time, const Bytes& bytes, unsigned interfaceNumber = 0)
    {
        return block(6, BytesBuilder()
                            .u32(interfaceNumber)
                            .u32(time >> 32)
                            .u32(time & 0xFFFFFFFF)
                            .u32(bytes.size())
                            .u32(bytes.size())
                            .raw(bytes)
                            .zeros((4 - bytes.size() % 4) % 4)
                            .bytes());
    }
    const Bytes& bytes() const { return content.bytes(); }

private:
    PcapngFile& block(std::uint32_t type, const Bytes& body)
    {
        content.u32(type).u32(12 + body.size()).raw(body).u32(12 + body.size());
        return *this;
    }
    BytesBuilder content;
};

} // namespace pelorus::test
