#include "LogGenerator/Osprey/LTE/NeighborCellsList.h"
#include "tests/support/HostilePackets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

// One cell, with the bits between its fields set.
PacketBuilder oneCell()
{
    return PacketBuilder(41)
        .bits(21, 0, 9, 301)
        .bits(21, 9, 8, 141)
        .bits(21, 17, 9, 95)
        .bits(21, 26, 6, 63)
        .bits(21, 32, 9, 94)
        .bits(21, 41, 7, 78)
        .bits(21, 48, 7, 75)
        .bits(21, 55, 7, 59)
        .bits(21, 62, 2, 3)
        .u16(29, 512)
        .u16(31, 65535)
        .bits(21, 96, 11, 1200)
        .bits(21, 107, 19, 30719)
        .bits(21, 126, 2, 3)
        .u32(37, 0xFFFFFFFF);
}

class NeighborCellsListTest : public testing::Test {
protected:
    SectionFixture<NeighborCellsList> section{makeArray()};

    std::string row(std::size_t cell, std::string_view label) const
    {
        return *section.entry.array()->elements.at(cell).dictionary()->at(label).string();
    }
};

TEST_F(NeighborCellsListTest, SubscribesToTheIdleModeNeighbors)
{
    EXPECT_EQ(section.section.getSectionName(), "Neighbor Cells List");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xB180));
}

TEST_F(NeighborCellsListTest, ShowsTheTwelveRowsOfACell)
{
    section.receive(0xB180, oneCell());
    EXPECT_EQ(section.shown(), "-\n"
                               "  Physical Cell ID: 301\n"
                               "  Measured RSSI: -69.50 dBm\n"
                               "  Measured RSRP: -92.50 dBm\n"
                               "  Average RSRP: -93.00 dBm\n"
                               "  Measured RSRQ: -10.50 dB\n"
                               "  Average RSRQ: -11.25 dB\n"
                               "  Srxlev: 29 dBm\n"
                               "  Frequency Offset: 512\n"
                               "  Ant 0 Frame Offset: 1200\n"
                               "  Ant 0 Sample Offset: 30719\n"
                               "  Ant 1 Frame Offset: 1200\n"
                               "  Ant 1 Sample Offset: 30719\n");
}

TEST_F(NeighborCellsListTest, LogsTheCountAndEachCellsLevelsUnderOneLabel)
{
    section.receive(0xB180, oneCell());
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Neighbor Cells List", "<4>Number of neighboring cells being reported: 1\n",
                            "<4>Physical Cell ID: 301\n", "<4>Measured RSSI: -69.500000\n",
                            "<4>Measured RSSI: -92.500000\n", "<4>Measured RSSI: -93.000000\n",
                            "<4>Measured RSSI: -10.500000\n", "<4>Measured RSSI: -11.250000\n"));
}

struct Extreme {
    unsigned first, width, value;
    const char* row;
    const char* text;
};

class NeighborCellsListField : public testing::TestWithParam<Extreme> {};

TEST_P(NeighborCellsListField, ShowsItsExtremes)
{
    SectionFixture<NeighborCellsList> section(makeArray());
    const auto& [first, width, value, row, text] = GetParam();
    section.receive(0xB180, PacketBuilder(41).bits(21, first, width, value));
    EXPECT_EQ(*section.entry.array()->elements.at(0).dictionary()->at(row).string(), text);
}

INSTANTIATE_TEST_SUITE_P(
    BothEnds, NeighborCellsListField,
    testing::Values(
        Extreme{0, 9, 0, "Physical Cell ID", "0"}, Extreme{0, 9, 511, "Physical Cell ID", "511"},
        Extreme{9, 8, 0, "Measured RSSI", "-140.00 dBm"}, Extreme{9, 8, 255, "Measured RSSI", "-12.50 dBm"},
        Extreme{17, 9, 0, "Measured RSRP", "-140.00 dBm"}, Extreme{17, 9, 280, "Measured RSRP", "0.00 dBm"},
        Extreme{17, 9, 511, "Measured RSRP", "115.50 dBm"}, Extreme{32, 9, 0, "Average RSRP", "-140.00 dBm"},
        Extreme{32, 9, 280, "Average RSRP", "0.00 dBm"}, Extreme{32, 9, 511, "Average RSRP", "115.50 dBm"},
        Extreme{41, 7, 0, "Measured RSRQ", "-30.00 dB"}, Extreme{41, 7, 127, "Measured RSRQ", "1.75 dB"},
        Extreme{48, 7, 0, "Average RSRQ", "-30.00 dB"}, Extreme{48, 7, 127, "Average RSRQ", "1.75 dB"},
        Extreme{55, 7, 0, "Srxlev", "-30 dBm"}, Extreme{55, 7, 127, "Srxlev", "97 dBm"},
        Extreme{64, 16, 65535, "Frequency Offset", "65535"}, // unsigned
        Extreme{96, 11, 2047, "Ant 0 Frame Offset", "2047"},
        Extreme{107, 19, 524287, "Ant 0 Sample Offset", "524287"},
        Extreme{96, 11, 2047, "Ant 1 Frame Offset", "2047"},
        Extreme{107, 19, 524287, "Ant 1 Sample Offset", "524287"}));

TEST_F(NeighborCellsListTest, CountsOneMoreCellThanTheFieldSays)
{
    PacketBuilder packet(21 + 32 * 20);
    for (unsigned cell = 0; cell < 32; ++cell)
        packet.bits(21 + 20 * cell, 0, 9, 100 + cell);
    section.receive(0xB180, packet);
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(row(0, "Physical Cell ID"), "100");
    section.logged();

    section.receive(0xB180, packet.bits(19, 6, 5, 31));
    EXPECT_EQ(section.rowCount(), 32U);
    EXPECT_EQ(row(31, "Physical Cell ID"), "131");
    EXPECT_EQ(section.logged().at(1), "<4>Number of neighboring cells being reported: 32\n");
}

TEST_F(NeighborCellsListTest, TakesNoBitsBesideTheCountForCells)
{
    section.receive(0xB180, PacketBuilder(21 + 40).bits(19, 0, 6, 63).bits(19, 11, 5, 31));
    EXPECT_EQ(section.rowCount(), 1U);
}

TEST_F(NeighborCellsListTest, ReplacesTheWholeListWithEveryPacket)
{
    section.receive(0xB180, PacketBuilder(21 + 60).bits(19, 6, 5, 2).u32(21, 0xFFFFFFFF));
    EXPECT_EQ(section.rowCount(), 3U);
    section.receive(0xB180, oneCell());
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(row(0, "Physical Cell ID"), "301");
}

TEST_F(NeighborCellsListTest, KeepsTheListWhenThePacketIsOneByteShort)
{
    section.receive(0xB180, oneCell());
    section.logged();
    section.receive(0xB180, PacketBuilder(20));
    EXPECT_EQ(row(0, "Physical Cell ID"), "301");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Neighbor Cells List"));
}

TEST_F(NeighborCellsListTest, EmptiesTheListWhenThePacketHoldsNoCell)
{
    section.receive(0xB180, oneCell());
    section.logged();
    section.receive(0xB180, PacketBuilder(21));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Neighbor Cells List", "<4>Number of neighboring cells being reported: 1\n"));
}

TEST_F(NeighborCellsListTest, LogsAForeignCodeAndKeepsTheList)
{
    section.receive(0xB180, oneCell());
    section.logged();
    section.receive(0xB179, PacketBuilder(41));
    EXPECT_EQ(row(0, "Physical Cell ID"), "301");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Neighbor Cells List", "<3>Received an unknown log message: 45433"));
}

TEST_F(NeighborCellsListTest, DropsTheCellsThatThePacketDoesNotHoldWhole)
{
    forEachPrefix(PacketBuilder(21 + 3 * 20 + 5).bits(19, 6, 5, 31).bytes(), [this](const LogPacket& packet) {
        section.section.updateWithData(packet, 0xB180);
        const std::size_t whole = packet.size() < 21 ? 0 : (packet.size() - 21) / 20;
        EXPECT_EQ(section.rowCount(), whole) << packet.size();
    });
}

} // namespace
} // namespace pelorus::test
