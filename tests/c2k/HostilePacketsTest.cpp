#include "tests/support/HostilePackets.h"
#include "LogGenerator/C2K/Decoders.h"
#include "tests/c2k/SubpacketBuilder.h"
#include "tests/support/RecordingLog.h"

#include <gtest/gtest.h>

namespace pelorus::test {
namespace {

struct Subject {
    const char* name;
    void (*decode)(PacketView data, State& state, const Lookup& lookup);
    PacketBuilder packet; // of the most pilots, subpackets and bytes that its code may have
};

std::vector<Subject> subjects()
{
    PacketBuilder activeSet = PacketBuilder(12).u16(4, 8).u8(6, 4).u8(7, 255).u8(8, 255).u8(9, 7);
    return {
        {"0x1183", decodeAirLinkSummary, PacketBuilder(50)},
        {"0x12B6", decodeActiveSetPilots, PacketBuilder(25 + 12 * 255).u8(15, 255)},
        {"0x108A", decodeFingers, PacketBuilder(23 + 14 * 255).u8(22, 255)},
        {"0x1192", decodeForwardLinkPackets, PacketBuilder(241)},
        {"0x127E", decodeReverseLinkPackets, PacketBuilder(1750)},
        {"0x119C", decodeOneXState,
         SubpacketBuilder()
             .add(1, PacketBuilder(5).u8(4, 8))
             .add(2, PacketBuilder(14))
             .add(4, PacketBuilder(4))
             .add(3, activeSet.length(12 + 56 * 255))
             .bytes()},
        {"0x119D", decodeOneXTraffic,
         SubpacketBuilder().add(9, PacketBuilder(4)).add(11, PacketBuilder(25)).claim(255).bytes()},
        {"0x134F", decodeSystemIdentity, PacketBuilder(186).u8(13, 2)},
    };
}

/// A display with one row for each key.
class HostilePackets : public testing::TestWithParam<Subject> {
protected:
    HostilePackets()
    {
        const auto entries = makeDictionary();
        for (const std::string_view key : kLookupKeys)
            entries->set(key, makeArray({makeDictionary({{"key", key}, {"dict", rows}})}));
        lookup = Lookup(*entries);
    }
    void decode(PacketView packet) { GetParam().decode(packet, state, lookup); }

    std::shared_ptr<Dictionary> rows = makeDictionary();
    Lookup lookup;
    State state{*makeDictionary({{"ExtraInfo", makeDictionary()}})};
    RecordingLog log;
};

TEST_P(HostilePackets, EveryPrefixStaysInside)
{
    std::size_t packets = 0;
    forEachPrefix(GetParam().packet.bytes(), [&](const LogPacket& packet) {
        ++packets;
        rows->clear();
        decode(packet);
        log.take();
    });
    EXPECT_EQ(packets, GetParam().packet.bytes().size() + 1);
    EXPECT_FALSE(rows->empty()); // the whole packet was shown
}

TEST_P(HostilePackets, RandomBytesStayInside)
{
    forRandomPackets(2000, 2000, [&](const LogPacket& packet) {
        decode(packet);
        log.take();
    });
    // Lengths that the decoder accepts, with everything else at random.
    std::mt19937 random(20120504); // NOLINT(cert-msc51-cpp): repeatable on purpose
    for (int round = 0; round < 500; ++round) {
        std::vector<std::byte> bytes = GetParam().packet.bytes();
        const std::size_t first = round % 2 == 0 ? 13 : 23; // behind the counts, too
        for (std::size_t place = first; place < bytes.size(); ++place)
            bytes[place] = static_cast<std::byte>(random());
        decode(PacketView(bytes));
        log.take();
    }
    EXPECT_LE(rows->size(), kLookupKeys.size());
}

INSTANTIATE_TEST_SUITE_P(Decoders, HostilePackets, testing::ValuesIn(subjects()),
                         [](const auto& subject) { return std::string(subject.param.name); });

} // namespace
} // namespace pelorus::test
