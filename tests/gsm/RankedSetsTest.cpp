#include "LogGenerator/Osprey/GSM/GSMSet.h"
#include "LogGenerator/Osprey/GSM/UMTSSet.h"
#include "tests/gsm/Packets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

TEST(UMTSSet, ShowsTheRankedCells)
{
    SectionFixture<UMTSSet> section(makeArray());
    section.receive(0x4005, rankedUMTSCells());
    EXPECT_EQ(section.shown(), "-\n"
                               "  Scrambling Code: 301\n"
                               "  RSCP: -101 dB\n"
                               "  Energy Per Chip: -6.500000 dB\n"
                               "  Downlink Frequency: 10713\n"
                               "  Ranking Value: -1201\n"
                               "  Rank Cell RSCP: -95 dB\n"
                               "-\n"
                               "  Scrambling Code: 511\n"
                               "  RSCP: -11 dB\n"
                               "  Energy Per Chip: 3.500000 dB\n"
                               "  Downlink Frequency: -1\n" // signed: meant
                               "  Ranking Value: 12\n"
                               "  Rank Cell RSCP: 300 dB\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>UMTSSet"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x4005, 0xFF0001));
}

TEST(UMTSSet, ShowsTheExtremesOfARankedCell)
{
    SectionFixture<UMTSSet> section(makeArray());
    section.receive(0x4005, PacketBuilder(35)
                                .u8(13, 2)
                                .u16(15, 0x8000)
                                .u16(17, 0xFFFF)
                                .s8(19, -128)
                                .s16(20, -32768)
                                .s8(22, -128)
                                .s16(23, -32768)
                                .u16(25, 0x7FFF)
                                .s8(29, 127)
                                .s16(30, 32767)
                                .s8(32, -1)
                                .s16(33, 32767));
    EXPECT_EQ(section.shown(), "-\n"
                               "  Scrambling Code: 65535\n"
                               "  RSCP: -149 dB\n"
                               "  Energy Per Chip: -64.000000 dB\n"
                               "  Downlink Frequency: -32768\n"
                               "  Ranking Value: -32768\n"
                               "  Rank Cell RSCP: -32768 dB\n"
                               "-\n"
                               "  Scrambling Code: 0\n"
                               "  RSCP: 106 dB\n"
                               "  Energy Per Chip: -0.500000 dB\n"
                               "  Downlink Frequency: 32767\n"
                               "  Ranking Value: 32767\n"
                               "  Rank Cell RSCP: 32767 dB\n");
}

TEST(GSMSet, ShowsTheRankedCells)
{
    SectionFixture<GSMSet> section(makeArray());
    section.receive(0x4005, rankedGSMCells());
    EXPECT_EQ(section.shown(), "-\n"
                               "  ARFCN: 871\n"
                               "  BSIC: 43\n"
                               "  RSSI: -77 dBm\n"
                               "  Ranking Value: -15\n"
                               "-\n"
                               "  ARFCN: 65535\n"
                               "  BSIC: 65534\n"
                               "  RSSI: 5 dBm\n"
                               "  Ranking Value: 900\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>GSMSet"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x4005));
}

TEST(RankedSets, ReadTheSameBytesEachInItsOwnStride)
{
    SectionFixture<UMTSSet> umts(makeArray());
    SectionFixture<GSMSet> gsm(makeArray());
    const PacketBuilder packet = rankedUMTSCells().u8(13, 1).u8(14, 1);
    umts.receive(0x4005, packet);
    gsm.receive(0x4005, packet);
    EXPECT_EQ(umts.rowCount(), 1U);
    // The UMTS cell's frequency, scrambling code, RSCP and rank RSCP.
    EXPECT_EQ(gsm.shown(), "-\n  ARFCN: 10713\n  BSIC: 301\n  RSSI: -80 dBm\n  Ranking Value: -95\n");
}

TEST(RankedSets, KeepTheirRowsBelow15BytesAndAreEmptiedByCountsOfNone)
{
    SectionFixture<UMTSSet> umts(makeArray());
    SectionFixture<GSMSet> gsm(makeArray());
    umts.receive(0x4005, rankedUMTSCells());
    gsm.receive(0x4005, rankedGSMCells());
    umts.receive(0x4005, PacketBuilder(14));
    gsm.receive(0x4005, PacketBuilder(14));
    EXPECT_EQ(umts.rowCount(), 2U);
    EXPECT_EQ(gsm.rowCount(), 2U);
    umts.receive(0x4005, PacketBuilder(15));
    gsm.receive(0x4005, PacketBuilder(15));
    EXPECT_EQ(umts.rowCount(), 0U);
    EXPECT_EQ(gsm.rowCount(), 0U);
}

TEST(RankedSets, DropCellsThatAreNotWhollyInThePacket)
{
    SectionFixture<UMTSSet> umts(makeArray());
    SectionFixture<GSMSet> gsm(makeArray());
    umts.receive(0x4005, rankedUMTSCells().length(34));
    gsm.receive(0x4005, rankedGSMCells().length(28));
    EXPECT_EQ(umts.rowCount(), 1U);
    EXPECT_EQ(gsm.rowCount(), 1U);
    umts.receive(0x4005, rankedUMTSCells().length(24));
    gsm.receive(0x4005, rankedGSMCells().length(21));
    EXPECT_EQ(umts.rowCount(), 0U);
    EXPECT_EQ(gsm.rowCount(), 0U);
}

TEST(UMTSSet, ShowsTheMonitoredNeighboursOfUMTSOnly)
{
    SectionFixture<UMTSSet> section(makeArray());
    section.receive(0x4005, rankedUMTSCells());
    section.logged();
    section.receive(0xFF0001,
                    monitoredCells({umtsServingCell(), umtsNeighbor(), gsmNeighbor(), umtsNeighbor()}));
    EXPECT_EQ(section.shown(), "-\n"
                               "  UARFCN: 10713\n"
                               "  Scrambling Code: 301\n"
                               "  RSCP: -95 dBm\n"
                               "  Energy Per Chip: -7 dB\n"
                               "-\n"
                               "  UARFCN: 10713\n"
                               "  Scrambling Code: 301\n"
                               "  RSCP: -95 dBm\n"
                               "  Energy Per Chip: -7 dB\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>UMTSSet"));
    section.receive(0x4005, rankedUMTSCells().u8(13, 1)); // and back: whichever came last
    EXPECT_EQ(section.shown(), "-\n"
                               "  Scrambling Code: 301\n"
                               "  RSCP: -101 dB\n"
                               "  Energy Per Chip: -6.500000 dB\n"
                               "  Downlink Frequency: 10713\n"
                               "  Ranking Value: -1201\n"
                               "  Rank Cell RSCP: -95 dB\n");
}

TEST(UMTSSet, ShowsAnEmptyTextForAMissingMeasurement)
{
    SectionFixture<UMTSSet> section(makeArray());
    section.receive(0xFF0001, monitoredCells({cell("UMTS", "Neighbor",
                                                   {{"CellMonitorUARFCN", 32767},
                                                    {"CellMonitorSCN", 32767},
                                                    {"CellMonitorRSCP", 32767},
                                                    {"CellMonitorECN0", 32767}})}));
    EXPECT_EQ(section.shown(), "-\n"
                               "  UARFCN: 32767\n"
                               "  Scrambling Code: 32767\n"
                               "  RSCP: \n"
                               "  Energy Per Chip: \n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>UMTSSet"));
}

TEST(UMTSSet, LogsEachMissingNumberAndKeepsTheRow)
{
    SectionFixture<UMTSSet> section(makeArray());
    section.receive(0xFF0001, monitoredCells({cell("UMTS", "Neighbor", {{"CellMonitorSCN", true}}),
                                              cell("UMTS", "Neighbor", {{"CellMonitorSCN", "77"}})}));
    EXPECT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.shown(), "-\n-\n  Scrambling Code: 77\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>UMTSSet", "<3>UMTSSet: Failed to retrieve UARFCN\n",
                                              "<3>UMTSSet: Failed to retrieve Scrambling Code\n",
                                              "<3>UMTSSet: Failed to retrieve RSCP\n",
                                              "<3>UMTSSet: Failed to retrieve Energy Per Chip\n",
                                              "<3>UMTSSet: Failed to retrieve UARFCN\n",
                                              "<3>UMTSSet: Failed to retrieve RSCP\n",
                                              "<3>UMTSSet: Failed to retrieve Energy Per Chip\n"));
}

} // namespace
} // namespace pelorus::test
