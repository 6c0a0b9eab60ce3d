#include "telephonyd/simulation/PacketWriter.h"

#include <gmock/gmock.h>

namespace pelorus::test {

namespace {

std::vector<int> written(Field field, std::int64_t value, std::byte before = std::byte{0})
{
    std::vector<std::byte> buffer(6 + PacketWriter::kSlack, before);
    PacketWriter(buffer, 1).put(field, value);
    std::vector<int> result;
    for (std::size_t i = 0; i < 6; ++i)
        result.push_back(std::to_integer<int>(buffer[i]));
    return result;
}

using testing::ElementsAre;

} // namespace

TEST(PacketWriter, PutsLittleEndianIntegersAtTheirOffset)
{
    EXPECT_THAT(written(u16(1), 0xB179), ElementsAre(0, 0, 0x79, 0xB1, 0, 0));
    EXPECT_THAT(written(u32(0), 0x01020304), ElementsAre(0, 4, 3, 2, 1, 0));
    EXPECT_THAT(written(s16(0), -2), ElementsAre(0, 0xFE, 0xFF, 0, 0, 0));
}

TEST(PacketWriter, LeavesTheBitsAroundABitFieldAlone)
{
    EXPECT_THAT(written(bits(1, 3, 10), 0, std::byte{0xFF}), ElementsAre(0xFF, 0xFF, 0x07, 0xE0, 0xFF, 0xFF));
    EXPECT_THAT(written(bits(0, 9, 4), 0xF), ElementsAre(0, 0, 0x1E, 0, 0, 0));
}

TEST(PacketWriter, WritesTheNearestValueThatFits)
{
    EXPECT_THAT(written(bits(0, 0, 7), 1000), ElementsAre(0, 0x7F, 0, 0, 0, 0));
    EXPECT_THAT(written(u8(0), -5), ElementsAre(0, 0, 0, 0, 0, 0));
    EXPECT_THAT(written(s8(0), -1000), ElementsAre(0, 0x80, 0, 0, 0, 0));
    EXPECT_THAT(written(s8(0), 1000), ElementsAre(0, 0x7F, 0, 0, 0, 0));
}

TEST(PacketWriter, FindsRecordsByTheirStride)
{
    std::vector<std::byte> buffer(32 + PacketWriter::kSlack);
    PacketWriter(buffer, 2).record({.start = 5, .stride = 4}, 3).put(u8(1), 7);
    EXPECT_EQ(std::to_integer<int>(buffer[2 + 5 + 12 + 1]), 7);
}

} // namespace pelorus::test
