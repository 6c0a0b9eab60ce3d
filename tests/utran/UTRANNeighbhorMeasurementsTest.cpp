#include "LogGenerator/Osprey/UTRAN/UTRANNeighbhorMeasurements.h"

#include "tests/support/HostilePackets.h"
#include "tests/support/SectionFixture.h"

#include <cstdio>
#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

/// A packet of `count` cells, all bytes 0.
PacketBuilder utranCells(unsigned count)
{
    return PacketBuilder(168 + 16 * count).u8(16, count << 1);
}

class UTRANNeighbhorMeasurementsTest : public testing::Test {
protected:
    SectionFixture<UTRANNeighbhorMeasurements> section{makeArray()};
};

TEST_F(UTRANNeighbhorMeasurementsTest, SubscribesToTheUTRANNeighbors)
{
    EXPECT_EQ(section.section.getSectionName(), "Neighbor Cell List");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xD00A));
}

TEST_F(UTRANNeighbhorMeasurementsTest, ShowsTheRowsOfEachCell)
{
    section.receive(0xD00A, utranCells(2)
                                .u8(16, 0x05) // bit 0 does not count
                                .bits(168, 0, 14, 10713)
                                .bits(168, 14, 7, 99)
                                .bits(168, 21, 8, 128)
                                .bits(168, 29, 2, 1)
                                .bits(168, 31, 1, 1)
                                .u32(172, 0xFFFFFFFF)
                                .bits(184, 0, 14, 16383)
                                .bits(184, 21, 8, 1));
    EXPECT_EQ(section.shown(), "-\n"
                               "  UARFCN: 10713\n"
                               "  Cell ID: 99\n"
                               "  Filter RSCP: 0.500000\n"
                               "  Status: MSET\n"
                               "  inJDCS: TRUE\n"
                               "-\n"
                               "  UARFCN: 16383\n"
                               "  Cell ID: 0\n"
                               "  Filter RSCP: 0.003906\n"
                               "  Status: ASET\n"
                               "  inJDCS: FALSE\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>NeighbhorMeasurements List"));
}

TEST_F(UTRANNeighbhorMeasurementsTest, LeavesTheStatusOutForACellOfNoSet)
{
    section.receive(0xD00A, utranCells(1).u32(168, 0xFFFFFFFF));
    EXPECT_EQ(section.shown(), "-\n"
                               "  UARFCN: 16383\n"
                               "  Cell ID: 127\n"
                               "  Filter RSCP: 0.996094\n"
                               "  inJDCS: TRUE\n");
}

TEST_F(UTRANNeighbhorMeasurementsTest, TurnsTheStatusRowOnAndOffFromPacketToPacket)
{
    section.receive(0xD00A, utranCells(1).bits(168, 29, 2, 2));
    EXPECT_EQ(section.shown(), "-\n"
                               "  UARFCN: 0\n"
                               "  Cell ID: 0\n"
                               "  Filter RSCP: 0.000000\n"
                               "  Status: DSET\n"
                               "  inJDCS: FALSE\n");
    section.receive(0xD00A, utranCells(1).bits(168, 29, 2, 3));
    EXPECT_EQ(section.shown(), "-\n"
                               "  UARFCN: 0\n"
                               "  Cell ID: 0\n"
                               "  Filter RSCP: 0.000000\n"
                               "  inJDCS: FALSE\n");
    section.receive(0xD00A, utranCells(1).bits(168, 29, 2, 0));
    EXPECT_EQ(section.shown(), "-\n"
                               "  UARFCN: 0\n"
                               "  Cell ID: 0\n"
                               "  Filter RSCP: 0.000000\n"
                               "  Status: ASET\n"
                               "  inJDCS: FALSE\n");
}

TEST_F(UTRANNeighbhorMeasurementsTest, ShowsEveryLevelInTwoHundredFiftySixths)
{
    for (unsigned level = 0; level < 256; ++level) {
        section.receive(0xD00A, utranCells(1).bits(168, 21, 8, level));
        char expected[32];
        std::snprintf(expected, sizeof expected, "%f", level / 256.0);
        EXPECT_EQ(*section.entry.array()->elements.at(0).dictionary()->at("Filter RSCP").string(), expected);
    }
}

TEST_F(UTRANNeighbhorMeasurementsTest, NoCellsEmptyTheList)
{
    section.receive(0xD00A, utranCells(3));
    EXPECT_EQ(section.rowCount(), 3U);
    section.receive(0xD00A, PacketBuilder(21).u8(16, 0x01));
    EXPECT_EQ(section.shown(), "");
}

TEST_F(UTRANNeighbhorMeasurementsTest, KeepsTheListWhenThePacketIsOneByteShort)
{
    section.receive(0xD00A, utranCells(3));
    section.logged();
    section.receive(0xD00A, PacketBuilder(20));
    EXPECT_EQ(section.rowCount(), 3U);
    EXPECT_THAT(section.logged(), ElementsAre("<4>NeighbhorMeasurements List"));
}

TEST_F(UTRANNeighbhorMeasurementsTest, IgnoresOtherCodes)
{
    section.receive(0xD00A, utranCells(3));
    section.logged();
    section.receive(0xD00E, utranCells(1));
    EXPECT_EQ(section.rowCount(), 3U);
    EXPECT_THAT(section.logged(), ElementsAre("<4>NeighbhorMeasurements List"));
}

TEST_F(UTRANNeighbhorMeasurementsTest, ShowsUpToOneHundredTwentySevenCells)
{
    section.receive(0xD00A, utranCells(127).u8(16, 0xFF));
    EXPECT_EQ(section.rowCount(), 127U);
}

TEST_F(UTRANNeighbhorMeasurementsTest, RaisesWhenThePacketEndsBeforeItsCellsAndLeavesTheListEmpty)
{
    section.receive(0xD00A, utranCells(3));
    EXPECT_THROW(section.receive(0xD00A, utranCells(2).length(168 + 31)), ArrayOutOfBoundsException);
    EXPECT_EQ(section.shown(), "");
    // What was raised in the middle of a list leaves no trace in the next one.
    section.receive(0xD00A, utranCells(2));
    EXPECT_EQ(section.rowCount(), 2U);
}

TEST_F(UTRANNeighbhorMeasurementsTest, RaisesForEveryPrefixThatIsLongEnoughForTheCountOnly)
{
    forEachPrefix(utranCells(2).bytes(), [this](const LogPacket& packet) {
        if (packet.size() >= 21 && packet.size() < 200)
            EXPECT_THROW(section.section.updateWithData(packet, 0xD00A), ArrayOutOfBoundsException)
                << packet.size();
        else
            EXPECT_NO_THROW(section.section.updateWithData(packet, 0xD00A)) << packet.size();
        EXPECT_EQ(section.rowCount(), packet.size() < 200 ? 0U : 2U) << packet.size();
    });
}

} // namespace
} // namespace pelorus::test
