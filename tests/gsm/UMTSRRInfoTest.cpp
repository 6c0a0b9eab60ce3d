#include "LogGenerator/Osprey/GSM/UMTSRRInfo.h"
#include "tests/gsm/Packets.h"
#include "tests/gsm/ShownText.h"
#include "tests/support/SectionFixture.h"

#include <algorithm>
#include <cstdio>
#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

TEST(UMTSRRInfo, ShowsEveryRowOfTheBasebandInTableOrder)
{
    SectionFixture<UMTSRRInfo> section(makeDictionary());
    section.receive(0x4125, radioResourceState());
    section.receive(0x4031, transmitPower());
    section.receive(0x4127, umtsCell());
    section.receive(0x4157, ciphering());
    EXPECT_EQ(section.shown(), "RRC State: CELL_DCH\n"
                               "Transmit Power: -9.00 dBm\n" // of 11 and -29; the 0 is no sample
                               "Cell ID: 180150000\n"
                               "Downlink Frequency: 10713\n"
                               "Uplink Frequency: 9763\n"
                               "URA ID: 65535\n"
                               "Ciphering: Enabled\n");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>UMTSRRInfo", "<4>UMTSRRInfo", "<4>UMTSRRInfo", "<4>UMTSRRInfo"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x4125, 0x4031, 0x4127, 0x4157, 0xFF0001));
}

TEST(UMTSRRInfo, ShowsThirtyTwoBitsAsSigned)
{
    SectionFixture<UMTSRRInfo> section(makeDictionary());
    section.receive(0x4127, PacketBuilder(29).u32(13, 0x80000000).u32(17, 0x7FFFFFFF).u32(21, 0xFFFFFFFF));
    EXPECT_EQ(section.shown(), "Cell ID: -1\n"
                               "Downlink Frequency: 2147483647\n"
                               "Uplink Frequency: -2147483648\n"
                               "URA ID: 0\n");
}

TEST(UMTSRRInfo, ShowsTheFrequencyOfTheCellMonitorUntilTheNextCell)
{
    SectionFixture<UMTSRRInfo> section(makeDictionary());
    section.receive(0xFF0001, monitoredCells({gsmServingCell(), umtsNeighbor(), umtsServingCell()}));
    EXPECT_EQ(section.shown(), "Cell ID: 8765\nUARFCN: 10588\nScrambling Code: 99\n");
    section.receive(0x4127, umtsCell());
    EXPECT_EQ(section.shown(), "Cell ID: 180150000\n"
                               "Scrambling Code: 99\n"
                               "Downlink Frequency: 10713\n"
                               "Uplink Frequency: 9763\n"
                               "URA ID: 65535\n");
    section.receive(0xFF0001, monitoredCells({umtsServingCell()}));
    EXPECT_EQ(section.row("Cell ID"), "8765");
    EXPECT_EQ(section.row("UARFCN"), "10588");
}

TEST(UMTSRRInfo, KeepsTheMonitorsFrequencyWhenTheCellIsOneByteShort)
{
    SectionFixture<UMTSRRInfo> section(makeDictionary());
    section.receive(0xFF0001, monitoredCells({umtsServingCell()}));
    section.receive(0x4127, umtsCell().length(28));
    EXPECT_EQ(section.shown(), "Cell ID: 8765\nUARFCN: 10588\nScrambling Code: 99\n");
}

TEST(UMTSRRInfo, LogsEachMissingNumberAndTriesTheNext)
{
    SectionFixture<UMTSRRInfo> section(makeDictionary());
    section.receive(0xFF0001, monitoredCells({cell("UMTS", "Serving", {})}));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>UMTSRRInfo", "<3>UMTSRRInfo: Failed to retrieve Cell ID\n",
                                              "<3>UMTSRRInfo: Failed to retrieve UARFCN\n",
                                              "<3>UMTSRRInfo: Failed to retrieve Scrambling Code\n"));
    section.receive(0xFF0001,
                    monitoredCells({cell(
                        "UMTS", "Serving",
                        {{"CellMonitorCellId", 7}, {"CellMonitorUARFCN", ""}, {"CellMonitorSCN", "+5"}})}));
    EXPECT_EQ(section.shown(), "Cell ID: 7\nScrambling Code: 5\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>UMTSRRInfo", "<3>UMTSRRInfo: Failed to retrieve UARFCN\n"));
}

// One entry of 14 bytes for each raw value.
PacketBuilder samples(const std::vector<int>& values)
{
    PacketBuilder packet(16 + 14 * values.size());
    packet.u8(14, static_cast<unsigned>(values.size()));
    for (std::size_t index = 0; index < values.size(); ++index)
        packet.s16(16 + 14 * index + 4, values[index]);
    return packet;
}

std::string shownPower(const PacketBuilder& packet)
{
    SectionFixture<UMTSRRInfo> section(makeDictionary());
    section.receive(0x4031, packet);
    return section.row("Transmit Power");
}

TEST(UMTSRRInfo, ShowsTheMeanAsPrintfShowsItInDoublePrecision)
{
    for (std::size_t count = 1; count <= 255; ++count)
        for (std::size_t ones = 0; ones <= count; ones += 1 + count / 20) {
            std::vector<int> values(count, 188); // 0 dBm
            std::fill_n(values.begin(), ones, 198);
            char text[32];
            std::snprintf(text, sizeof text, "%4.2f dBm",
                          static_cast<double>(ones) / static_cast<double>(count));
            ASSERT_EQ(shownPower(samples(values)), text) << ones << " of " << count;
        }
}

TEST(UMTSRRInfo, TakesTheMeanOfTheTransmitPower)
{
    EXPECT_EQ(shownPower(samples({300})), "11.00 dBm");
    EXPECT_EQ(shownPower(samples({198, 188, 188})), "0.33 dBm");
    EXPECT_EQ(shownPower(samples({208, 188, 188})), "0.67 dBm");
    EXPECT_EQ(shownPower(samples({198, 188, 188, 188, 188, 188, 188, 188})), "0.12 dBm"); // 0.125, to even
    EXPECT_EQ(shownPower(samples({178, 188, 188, 188, 188, 188, 188, 188})), "-0.12 dBm");
    EXPECT_EQ(shownPower(samples({198, 178})), "0.00 dBm");
    std::vector<int> nearlyNone(255, 188);
    nearlyNone[254] = 178;
    EXPECT_EQ(shownPower(samples(nearlyNone)), "-0.00 dBm");
}

TEST(UMTSRRInfo, RoundsEachSampleTowardsZero)
{
    EXPECT_EQ(shownPower(samples({-600})), "-78.00 dBm"); // -8.8 and -70
    EXPECT_EQ(shownPower(samples({-513})), "-70.00 dBm");
    EXPECT_EQ(shownPower(samples({-503})), "-70.00 dBm");
    EXPECT_EQ(shownPower(samples({-502})), "-69.00 dBm");
    EXPECT_EQ(shownPower(samples({1})), "-19.00 dBm");
    EXPECT_EQ(shownPower(samples({-1})), "-19.00 dBm");
    EXPECT_EQ(shownPower(samples({32767})), "3257.00 dBm");
    EXPECT_EQ(shownPower(samples({-32768})), "-3295.00 dBm");
}

// 0 / 0 on x86-64 has its sign bit set, and printf shows it.
#ifdef __x86_64__
constexpr const char* kNoMean = "-nan dBm";
#else
constexpr const char* kNoMean = " nan dBm";
#endif

TEST(UMTSRRInfo, ShowsAMeanOfNoSamplesAsItStands)
{
    EXPECT_EQ(shownPower(samples({})), kNoMean);
    EXPECT_EQ(shownPower(samples({0, 0})), kNoMean);
}

TEST(UMTSRRInfo, DropsSamplesThatAreNotWhollyInThePacket)
{
    EXPECT_EQ(shownPower(samples({300, -100}).length(43)), "11.00 dBm");
    EXPECT_EQ(shownPower(samples({300, -100}).u8(14, 255)), "-9.00 dBm");
    EXPECT_EQ(shownPower(samples({300}).length(29)), kNoMean);
}

INSTANTIATE_TEST_SUITE_P(UMTSRRInfoState, ShownTextOf,
                         shownTexts("UMTS RR Info", 0x4125, 14, 13, "RRC State",
                                    {{0, "Disconnected"},
                                     {1, "Connecting"},
                                     {2, "CELL_FACH"},
                                     {3, "CELL_DCH"},
                                     {4, "CELL_PCH"},
                                     {5, "URA_PCH"},
                                     {6, "Unknown"},
                                     {255, "Unknown"}}));
INSTANTIATE_TEST_SUITE_P(UMTSRRInfoCiphering, ShownTextOf,
                         shownTexts("UMTS RR Info", 0x4157, 19, 13, "Ciphering",
                                    {{0, "Disabled"}, {1, "Enabled"}, {255, "Enabled"}}));

} // namespace
} // namespace pelorus::test
