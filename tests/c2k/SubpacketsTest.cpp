#include "LogGenerator/C2K/Subpackets.h"

#include "tests/c2k/SubpacketBuilder.h"
#include "tests/support/RecordingLog.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class Subpackets : public testing::Test {
protected:
    /// The length of the subpacket found, -1 for none.
    int find(SubpacketBuilder builder, unsigned identifier)
    {
        packet = builder.bytes().bytes();
        found = findSubpacket(PacketView(packet), identifier);
        return found ? static_cast<int>(found->size()) : -1;
    }

    RecordingLog log;
    std::vector<std::byte> packet;
    std::optional<PacketView> found;
};

TEST_F(Subpackets, AreFoundByTheirIdentifier)
{
    const auto builder = SubpacketBuilder().add(7, PacketBuilder(6)).add(9, PacketBuilder(8).u8(5, 42));
    EXPECT_EQ(find(builder, 7), 6);
    EXPECT_EQ(find(builder, 9), 8);
    EXPECT_EQ((*found)[u8(5)], 42);
    EXPECT_EQ(find(builder, 8), -1);
    EXPECT_EQ(find(builder, 0), -1);
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(Subpackets, TheFirstOfTwoIsFound)
{
    find(SubpacketBuilder().add(7, PacketBuilder(6).u8(4, 1)).add(7, PacketBuilder(6).u8(4, 2)), 7);
    EXPECT_EQ((*found)[u8(4)], 1);
}

TEST_F(Subpackets, EndWithTheirCount)
{
    auto builder = SubpacketBuilder().add(7, PacketBuilder(6)).add(9, PacketBuilder(8));
    EXPECT_EQ(find(builder.claim(1), 9), -1);
    EXPECT_EQ(find(builder.claim(0), 7), -1);
    EXPECT_EQ(find(builder.claim(2), 9), 8);
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(Subpackets, OfSizeZeroStandsStill)
{
    auto builder = SubpacketBuilder().addSized(7, 0, PacketBuilder(6));
    EXPECT_EQ(find(builder, 7), 0);
    EXPECT_EQ(find(builder.claim(255), 9), -1);
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(Subpackets, OfSizeThreeOverlapsTheNextOne)
{
    // The high byte of its size, at 20, is the identifier of the next one.
    packet = PacketBuilder(30).u8(14, 2).u8(17, 7).u16(19, 3).u16(22, 6).bytes();
    found = findSubpacket(PacketView(packet), 7);
    ASSERT_TRUE(found);
    EXPECT_EQ(found->size(), 3U);
    found = findSubpacket(PacketView(packet), 0);
    ASSERT_TRUE(found);
    EXPECT_EQ(found->size(), 6U);
    EXPECT_THAT(log.take(), IsEmpty());
}

// The packet is 27 bytes long, so the bound is at 44; the one subpacket starts at 17.
TEST_F(Subpackets, MayEndSeventeenBytesBehindThePacketAndNotOneMore)
{
    EXPECT_EQ(find(SubpacketBuilder().addSized(7, 11, PacketBuilder(10)), 7), 10);
    EXPECT_EQ(find(SubpacketBuilder().addSized(7, 26, PacketBuilder(10)), 7), 10);
    EXPECT_THAT(log.take(), IsEmpty());
    EXPECT_EQ(find(SubpacketBuilder().addSized(7, 27, PacketBuilder(10)), 7), -1);
    EXPECT_EQ(find(SubpacketBuilder().addSized(7, 28, PacketBuilder(10)), 7), -1);
    EXPECT_EQ(find(SubpacketBuilder().addSized(7, 65535, PacketBuilder(10)), 7), -1);
    EXPECT_THAT(log.take(), ElementsAre("<3>Log code error in subpkt#0: bad size (27).",
                                        "<3>Log code error in subpkt#0: bad size (28).",
                                        "<3>Log code error in subpkt#0: bad size (65535)."));
}

TEST_F(Subpackets, BehindOneOfBadSizeAreNotFound)
{
    const auto builder = SubpacketBuilder()
                             .add(7, PacketBuilder(6))
                             .addSized(8, 1000, PacketBuilder(8))
                             .add(9, PacketBuilder(8));
    EXPECT_EQ(find(builder, 7), 6);
    EXPECT_THAT(log.take(), IsEmpty());
    EXPECT_EQ(find(builder, 8), -1);
    EXPECT_EQ(find(builder, 9), -1);
    EXPECT_THAT(log.take(), ElementsAre("<3>Log code error in subpkt#1: bad size (1000).",
                                        "<3>Log code error in subpkt#1: bad size (1000)."));
}

// Their headers read as 0: identifier 0, size 0.
TEST_F(Subpackets, BehindThePacketAreEmpty)
{
    const auto builder = SubpacketBuilder().addSized(7, 26, PacketBuilder(10)).claim(2);
    EXPECT_EQ(find(builder, 9), -1);
    EXPECT_EQ(find(builder, 0), 0);
    EXPECT_THAT(log.take(), IsEmpty());
}

} // namespace
} // namespace pelorus::test
