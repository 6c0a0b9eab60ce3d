#include "telephonyd/simulation/MessageBatch.h"

#include "tests/telephonyd/PacketReader.h"

#include <gtest/gtest.h>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;

constexpr HandsetTime kMidnight = std::chrono::sys_days(std::chrono::year(2024) / 5 / 1);

} // namespace

TEST(MessageBatch, FillsInTheHeader)
{
    MessageBatch batch(kMidnight);
    batch.packet(0xB17F, 33).put(u8(32), 9);
    const PacketReader packet(batch[0].bytes);
    ASSERT_EQ(packet.size(), 33U);
    EXPECT_EQ(packet.u8(0), 1);
    EXPECT_EQ(packet.u16(1), 32); // without the log type
    EXPECT_EQ(packet.u16(3), 0xB17F);
    EXPECT_EQ(packet.u8(32), 9);
    EXPECT_EQ(batch[0].code, 0xB17FU);
}

TEST(MessageBatch, GivesListsTheServersLogType)
{
    MessageBatch batch(kMidnight);
    const std::vector<std::byte> list(300, std::byte{'x'});
    batch.list(0xFF0001, list);
    const PacketReader packet(batch[0].bytes);
    ASSERT_EQ(packet.size(), 313U);
    EXPECT_EQ(packet.u8(0), 0xFF);
    EXPECT_EQ(packet.u16(1), 312);
    EXPECT_EQ(packet.u16(3), 1);
    EXPECT_EQ(packet.u8(13), 'x');
    EXPECT_EQ(packet.u8(312), 'x');
    EXPECT_EQ(batch[0].code, 0xFF0001U);
}

TEST(MessageBatch, StampsUnitsOf1250MicrosecondsSince1980)
{
    EXPECT_EQ(logTime(HandsetTime(std::chrono::sys_days(std::chrono::year(1980) / 1 / 6))), 0U);
    // 16187 days and 3.125 ms later
    EXPECT_EQ(logTime(kMidnight + 3125us), (16187ULL * 86400 * 800 + 2) << 16 | 0x8000);

    MessageBatch batch(kMidnight);
    batch.setTime(3125us);
    batch.packet(0xB0C1, 22);
    const PacketReader packet(batch[0].bytes);
    EXPECT_EQ(packet.u16(5), 0x8000);
    EXPECT_EQ(packet.u16(7), (16187ULL * 86400 * 800 + 2) & 0xFFFF);
    EXPECT_EQ(packet.u16(9), (16187ULL * 86400 * 800 + 2) >> 16 & 0xFFFF);
}

TEST(MessageBatch, DoesNotCarryOldBytesIntoNewPackets)
{
    MessageBatch batch(kMidnight);
    batch.list(0xFF0000, std::vector<std::byte>(100, std::byte{0xEE}));
    batch.packet(0xB17F, 33).put(u8(32), 0xFF); // writes into the slack behind it
    batch.packet(0xB0C1, 22);
    batch.clear();
    batch.packet(0xB17F, 33);
    batch.packet(0xB0C1, 22);
    ASSERT_EQ(batch.size(), 2U);
    for (std::size_t message = 0; message < 2; ++message)
        for (const std::byte byte : PacketReader(batch[message].bytes).payload())
            EXPECT_EQ(byte, std::byte{0});
}

} // namespace pelorus::test
