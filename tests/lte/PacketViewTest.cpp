#include "LogGenerator/Osprey/PacketView.h"

#include "LogGenerator/Osprey/LogPacket.h"
#include "tests/support/PacketBuilder.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

class PacketViewTest : public testing::Test {
protected:
    // 01 02 ... 0A FF, in memory of its own size
    PacketViewTest()
    {
        for (unsigned place = 0; place < 10; ++place)
            content.push_back(static_cast<std::byte>(place + 1));
        content.push_back(std::byte{0xFF});
        content.shrink_to_fit();
    }
    PacketView view() const { return PacketView(content); }

    std::vector<std::byte> content;
};

TEST_F(PacketViewTest, ReadsLittleEndianFromAnyByte)
{
    EXPECT_EQ(view()[u8(0)], 1);
    EXPECT_EQ(view()[u16(1)], 0x0302);
    EXPECT_EQ(view()[u32(1)], 0x05040302);
    EXPECT_EQ(view()[s16(3)], 0x0504);
    EXPECT_EQ(view()[u8(10)], 255);
    EXPECT_EQ(view()[s8(10)], -1);
    EXPECT_EQ(view()[u16(9)], 0xFF0A);
    EXPECT_EQ(view()[s16(9)], -246);
    EXPECT_EQ(view()[u32(7)], 0xFF0A0908);
    EXPECT_EQ(view()[s32(7)], -16119544);
}

TEST_F(PacketViewTest, ReadsBitsFromTheBitStringAtAByte)
{
    EXPECT_EQ(view()[bits(0, 0, 1)], 1);
    EXPECT_EQ(view()[bits(0, 8, 4)], 2);
    EXPECT_EQ(view()[bits(0, 1, 9)], 0x100); // 0x0201 >> 1, 9 bits
    EXPECT_EQ(view()[bits(9, 7, 9)], 0x1FE);
    EXPECT_EQ(view()[bits(10, 7, 1)], 1);
    EXPECT_EQ(view()[bits(4, 39, 17)], 0x1FE14); // 17 bits across three bytes, up to the last
}

TEST_F(PacketViewTest, RefusesAFieldThatIsNotWhollyInside)
{
    EXPECT_THROW(view()[u8(11)], std::out_of_range);
    EXPECT_THROW(view()[u16(10)], std::out_of_range);
    EXPECT_THROW(view()[u32(8)], std::out_of_range);
    EXPECT_THROW(view()[bits(10, 7, 2)], std::out_of_range);
    EXPECT_THROW(PacketView()[u8(0)], std::out_of_range);
}

TEST_F(PacketViewTest, PadsWithZeros)
{
    EXPECT_EQ(view().padded(u16(9)), 0xFF0A);
    EXPECT_EQ(view().padded(u16(10)), 0x00FF);
    EXPECT_EQ(view().padded(u32(9)), 0x0000FF0A);
    EXPECT_EQ(view().padded(u8(11)), 0);
    EXPECT_EQ(view().padded(u32(4000)), 0);
    EXPECT_EQ(PacketView().padded(u8(14)), 0);
}

TEST_F(PacketViewTest, KnowsWhatItCovers)
{
    EXPECT_TRUE(view().covers(11));
    EXPECT_FALSE(view().covers(12));
    EXPECT_EQ(view().size(), 11U);
    EXPECT_THAT(view().from(9), ElementsAre(std::byte{0x0A}, std::byte{0xFF}));
    EXPECT_TRUE(view().from(11).empty());
    EXPECT_TRUE(view().from(4000).empty());
}

TEST_F(PacketViewTest, CountsTheRecordsThatLieWhollyInside)
{
    EXPECT_EQ(view().wholeRecords({.start = 1, .stride = 5}, 255), 2U);
    EXPECT_EQ(view().wholeRecords({.start = 1, .stride = 5}, 1), 1U);
    EXPECT_EQ(view().wholeRecords({.start = 1, .stride = 5}, 0), 0U);
    EXPECT_EQ(view().wholeRecords({.start = 2, .stride = 5}, 255), 1U);
    EXPECT_EQ(view().wholeRecords({.start = 11, .stride = 5}, 255), 0U);
    EXPECT_EQ(view().wholeRecords({.start = 9000, .stride = 5}, 255), 0U);
    EXPECT_EQ(view().wholeRecords({.start = 1, .stride = 3, .length = 7}, 255), 2U);
    EXPECT_EQ(view().wholeRecords({.start = 1, .stride = 3, .length = 2}, 255), 3U);
}

TEST_F(PacketViewTest, GivesARecordWhoseFieldsCannotLeaveIt)
{
    const PacketView second = view().record({.start = 1, .stride = 5}, 1, 2);
    EXPECT_EQ(second.size(), 5U);
    EXPECT_EQ(second[u8(0)], 7);
    EXPECT_EQ(second[u8(4)], 255);
    const PacketView first = view().record({.start = 1, .stride = 5}, 0, 2);
    EXPECT_THROW(first[u16(4)], std::out_of_range);
}

TEST_F(PacketViewTest, RaisesForARecordThatTheCountOrThePacketDoesNotHold)
{
    EXPECT_NO_THROW(view().record({.start = 1, .stride = 5}, 1, 2));
    EXPECT_THROW(view().record({.start = 1, .stride = 5}, 1, 1), ArrayOutOfBoundsException);
    EXPECT_THROW(view().record({.start = 1, .stride = 5}, 0, 0), ArrayOutOfBoundsException);
    EXPECT_THROW(view().record({.start = 1, .stride = 5}, 2, 255), ArrayOutOfBoundsException);
    EXPECT_THROW(view().record({.start = 2, .stride = 5}, 1, 2), ArrayOutOfBoundsException);
}

TEST_F(PacketViewTest, ReachesBeyondARecordAndPads)
{
    const auto reach = view().recordAndBeyond<6>({.start = 3, .stride = 4}, 1, 2);
    EXPECT_THAT(reach, ElementsAre(std::byte{8}, std::byte{9}, std::byte{10}, std::byte{0xFF}, std::byte{0},
                                   std::byte{0}));
    EXPECT_THROW(view().recordAndBeyond<6>({.start = 3, .stride = 4}, 2, 3), ArrayOutOfBoundsException);
    EXPECT_THROW(view().recordAndBeyond<6>({.start = 3, .stride = 4}, 1, 1), ArrayOutOfBoundsException);
}

TEST(ArrayOutOfBoundsException, IsNamedAfterItself)
{
    const ArrayOutOfBoundsException exception;
    const std::exception& base = exception;
    EXPECT_STREQ(base.what(), "ArrayOutOfBoundsException");
}

TEST(LogPacket, ReadsThePropertyListBehindItsHeader)
{
    const PacketBuilder packet = internalPacket(makeArray({"a"}));
    EXPECT_EQ(LogPacket(packet.bytes()).propertyList(), Value(makeArray({"a"})));
}

TEST(LogPacket, HasNoPropertyListWhenItEndsBeforeOne)
{
    for (const std::size_t length : {0, 1, 12, 13})
        EXPECT_FALSE(LogPacket(PacketBuilder(length).bytes()).propertyList()) << length;
    const PacketBuilder whole = internalPacket(makeArray({"a"}));
    EXPECT_FALSE(LogPacket(PacketBuilder(whole).length(whole.bytes().size() - 1).bytes()).propertyList());
}

} // namespace
} // namespace pelorus::test
