#include "LogGenerator/Osprey/LTE/MeasuredNeighborCells.h"
#include "tests/support/HostilePackets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

PacketBuilder twoCells()
{
    return PacketBuilder(41).u8(27, 2).u16(29, 301).u16(31, 190).u16(33, 75).u16(35, 302).u16(37, 0).u16(39,
                                                                                                         0);
}

class MeasuredNeighborCellsTest : public testing::Test {
protected:
    SectionFixture<MeasuredNeighborCells> section{makeArray()};
};

TEST_F(MeasuredNeighborCellsTest, SubscribesToTheConnectedModeMeasurement)
{
    EXPECT_EQ(section.section.getSectionName(), "Measured Neighbor Cells");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xB179));
}

TEST_F(MeasuredNeighborCellsTest, ShowsOneDictionaryACell)
{
    section.receive(0xB179, twoCells());
    EXPECT_EQ(section.shown(), "-\n"
                               "  Physical Cell ID: 301\n"
                               "  Filtered RSRP: -92.50 dBm\n"
                               "  Filtered RSRQ: -10.62 dB\n"
                               "-\n"
                               "  Physical Cell ID: 302\n"
                               "  Filtered RSRP: -140.00 dBm\n"
                               "  Filtered RSRQ: -20.00 dB\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Measured Neighbor Cells"));
}

TEST_F(MeasuredNeighborCellsTest, UsesAllSixteenBitsOfALevel)
{
    section.receive(0xB179, PacketBuilder(35).u8(27, 1).u16(29, 65535).u16(31, 65535).u16(33, 65535));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Physical Cell ID: 65535\n"
                               "  Filtered RSRP: 16243.75 dBm\n"
                               "  Filtered RSRQ: 8171.88 dB\n");
}

TEST_F(MeasuredNeighborCellsTest, ReplacesTheWholeListWithEveryPacket)
{
    section.receive(0xB179, twoCells());
    section.receive(0xB179, PacketBuilder(35).u8(27, 1).u16(29, 7).u16(31, 560).u16(33, 160));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Physical Cell ID: 7\n"
                               "  Filtered RSRP: 0.00 dBm\n"
                               "  Filtered RSRQ: 0.00 dB\n");
    section.receive(0xB179, twoCells());
    EXPECT_EQ(section.rowCount(), 2U);
}

TEST_F(MeasuredNeighborCellsTest, NoCellsEmptyTheList)
{
    section.receive(0xB179, twoCells());
    section.receive(0xB179, PacketBuilder(29).u8(28, 4));
    EXPECT_EQ(section.shown(), "");
}

TEST_F(MeasuredNeighborCellsTest, KeepsTheListWhenThePacketIsOneByteShort)
{
    section.receive(0xB179, twoCells());
    const std::string before = section.shown();
    section.logged();
    section.receive(0xB179, PacketBuilder(28));
    EXPECT_EQ(section.shown(), before);
    EXPECT_THAT(section.logged(), ElementsAre("<4>Measured Neighbor Cells"));
}

TEST_F(MeasuredNeighborCellsTest, LogsAForeignCodeAndKeepsTheList)
{
    section.receive(0xB179, twoCells());
    section.logged();
    section.receive(0xB180, PacketBuilder(29));
    EXPECT_EQ(section.rowCount(), 2U);
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Measured Neighbor Cells", "<3>Received an unknown log message: 45440"));
}

TEST_F(MeasuredNeighborCellsTest, DropsTheCellsThatThePacketDoesNotHoldWhole)
{
    forEachPrefix(PacketBuilder(29 + 3 * 6).u8(27, 255).bytes(), [this](const LogPacket& packet) {
        section.section.updateWithData(packet, 0xB179);
        const std::size_t whole = packet.size() < 29 ? 0 : (packet.size() - 29) / 6;
        EXPECT_EQ(section.rowCount(), whole) << packet.size();
    });
}

TEST_F(MeasuredNeighborCellsTest, ShowsUpToTwoHundredFiftyFiveCells)
{
    section.receive(0xB179, PacketBuilder(29 + 255 * 6).u8(27, 255).u16(29 + 254 * 6, 503));
    EXPECT_EQ(section.rowCount(), 255U);
    EXPECT_EQ(textOf(section.entry.array()->elements[254]), "Physical Cell ID: 503\n"
                                                            "Filtered RSRP: -140.00 dBm\n"
                                                            "Filtered RSRQ: -20.00 dB\n");
}

} // namespace
} // namespace pelorus::test
