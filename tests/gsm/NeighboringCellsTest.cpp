#include "LogGenerator/Osprey/GSM/NeighboringCells.h"
#include "tests/gsm/Packets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

constexpr const char* kWithoutIdentities = "-\n"
                                           "  ARFCN: 62\n"
                                           "  RSSI: 55\n"
                                           "  C1 Value: -14\n"
                                           "-\n"
                                           "  ARFCN: 1023\n"
                                           "  RSSI: 255\n"
                                           "  C1 Value: 100000\n";

TEST(NeighboringCells, ShowsNoIdentityBeforeAnyWasDecoded)
{
    SectionFixture<NeighboringCells> section(makeArray());
    section.receive(0x5137, gsmMeasurement());
    EXPECT_EQ(section.shown(), kWithoutIdentities);
    EXPECT_THAT(section.logged(), ElementsAre("<4>NeighboringCells"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x5137, 0x51FF, 0xFF0001));
}

TEST(NeighboringCells, ShowsTheIdentityOfTheChannelsThatAreKnown)
{
    SectionFixture<NeighboringCells> section(makeArray());
    section.receive(0x51FF, stationIdentities());
    EXPECT_EQ(section.shown(), "");
    section.receive(0x5137, gsmMeasurement());
    EXPECT_EQ(section.shown(), "-\n"
                               "  ARFCN: 62\n"
                               "  RSSI: 55\n"
                               "  C1 Value: -14\n"
                               "  BSIC: 33\n"
                               "-\n"
                               "  ARFCN: 1023\n"
                               "  RSSI: 255\n"
                               "  C1 Value: 100000\n");
}

TEST(NeighboringCells, DoesNotTouchTheListWhenIdentitiesCome)
{
    SectionFixture<NeighboringCells> section(makeArray());
    section.receive(0x5137, gsmMeasurement());
    section.receive(0x51FF, stationIdentities());
    EXPECT_EQ(section.shown(), kWithoutIdentities);
}

TEST(NeighboringCells, ForgetsIdentitiesThatAreNotSentAgain)
{
    SectionFixture<NeighboringCells> section(makeArray());
    section.receive(0x51FF, stationIdentities());
    section.receive(0x51FF, PacketBuilder(19).u8(14, 1).u16(15, 1023).u8(17, 0));
    section.receive(0x5137, gsmMeasurement());
    EXPECT_EQ(section.shown(), std::string(kWithoutIdentities) + "  BSIC: 0\n");
    section.receive(0x51FF, stationIdentities());
    section.receive(0x51FF, PacketBuilder(15));
    section.receive(0x5137, gsmMeasurement());
    EXPECT_EQ(section.shown(), kWithoutIdentities);
}

TEST(NeighboringCells, KeepsTheLastIdentityOfAChannelSentTwice)
{
    SectionFixture<NeighboringCells> section(makeArray());
    section.receive(
        0x51FF,
        PacketBuilder(27).u8(14, 3).u16(15, 65535).u8(17, 1).u16(19, 65535).u8(21, 255).u16(23, 0).u8(25, 7));
    section.receive(0x5137, PacketBuilder(57).u8(28, 2).u16(29, 65535));
    EXPECT_EQ(section.shown(), "-\n  ARFCN: 65535\n  RSSI: 0\n  C1 Value: 0\n  BSIC: 255\n"
                               "-\n  ARFCN: 0\n  RSSI: 0\n  C1 Value: 0\n  BSIC: 7\n");
}

TEST(NeighboringCells, KeepsItsIdentitiesWhenThePacketIsOneByteShort)
{
    SectionFixture<NeighboringCells> section(makeArray());
    section.receive(0x51FF, stationIdentities());
    section.receive(0x51FF, PacketBuilder(14));
    section.receive(0x5137, gsmMeasurement());
    EXPECT_EQ(*section.entry.array()->elements.at(0).dictionary()->at("BSIC").string(), "33");
    section.receive(0x51FF, PacketBuilder(15));
    section.receive(0x5137, gsmMeasurement());
    EXPECT_EQ(section.shown(), kWithoutIdentities);
}

TEST(NeighboringCells, DropsIdentitiesThatAreNotWhollyInThePacket)
{
    SectionFixture<NeighboringCells> section(makeArray());
    section.receive(0x51FF, PacketBuilder(22).u8(14, 2).u16(15, 62).u8(17, 5).u16(19, 1023).u8(21, 6));
    section.receive(0x5137, gsmMeasurement());
    EXPECT_EQ(section.shown(), "-\n"
                               "  ARFCN: 62\n"
                               "  RSSI: 55\n"
                               "  C1 Value: -14\n"
                               "  BSIC: 5\n"
                               "-\n"
                               "  ARFCN: 1023\n"
                               "  RSSI: 255\n"
                               "  C1 Value: 100000\n");
}

TEST(NeighboringCells, DropsNeighboursThatAreNotWhollyInThePacket)
{
    SectionFixture<NeighboringCells> section(makeArray());
    section.receive(0x5137, gsmMeasurement().length(56));
    EXPECT_EQ(section.shown(), "-\n  ARFCN: 62\n  RSSI: 55\n  C1 Value: -14\n");
    section.receive(0x5137, gsmMeasurement().length(42));
    EXPECT_EQ(section.shown(), "");
    section.receive(0x5137, gsmMeasurement().u8(28, 255));
    EXPECT_EQ(section.shown(), kWithoutIdentities);
}

TEST(NeighboringCells, IsEmptiedByACountOfNoneAndKeptBelow29Bytes)
{
    SectionFixture<NeighboringCells> section(makeArray());
    section.receive(0x5137, gsmMeasurement());
    section.receive(0x5137, PacketBuilder(28));
    EXPECT_EQ(section.shown(), kWithoutIdentities);
    section.receive(0x5137, gsmMeasurement().u8(28, 0));
    EXPECT_EQ(section.shown(), "");
}

TEST(NeighboringCells, ShowsTheMonitoredNeighboursOfGSMWithTwiceTheirLevel)
{
    SectionFixture<NeighboringCells> section(makeArray());
    section.receive(0x51FF, stationIdentities());
    section.receive(0x5137, gsmMeasurement());
    section.logged();
    section.receive(0xFF0001, monitoredCells({gsmServingCell(), gsmNeighbor(), umtsNeighbor(),
                                              cell("GSM", "Neighbor",
                                                   {{"CellMonitorARFCN", 62}, {"CellMonitorRSSI", 32767}})}));
    EXPECT_EQ(section.shown(), "-\n  ARFCN: 88\n  RSSI: -100 dBm\n"
                               "-\n  ARFCN: 62\n  RSSI: \n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>NeighboringCells"));
}

TEST(NeighboringCells, LogsEachMissingNumberAndKeepsTheRow)
{
    SectionFixture<NeighboringCells> section(makeArray());
    section.receive(0xFF0001, monitoredCells({cell("GSM", "Neighbor", {}),
                                              cell("GSM", "Neighbor", {{"CellMonitorRSSI", "-40"}}),
                                              cell("GSM", "Neighbor", {{"CellMonitorARFCN", 5}})}));
    EXPECT_EQ(section.shown(), "-\n-\n  RSSI: -80 dBm\n-\n  ARFCN: 5\n");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>NeighboringCells", "<3>NeighboringCells: Failed to retrieve ARFCN\n",
                            "<3>NeighboringCells: Failed to retrieve RSSI\n",
                            "<3>NeighboringCells: Failed to retrieve ARFCN\n",
                            "<3>NeighboringCells: Failed to retrieve RSSI\n"));
}

} // namespace
} // namespace pelorus::test
