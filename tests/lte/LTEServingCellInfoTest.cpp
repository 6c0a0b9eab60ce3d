#include "LogGenerator/Osprey/LTE/LTEServingCellInfo.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

constexpr LogCode kConfiguration = 0xB0C2;
constexpr LogCode kInformationBlock = 0xB0C1;
constexpr LogCode kCells = 0xFF0001;

PacketBuilder configuration()
{
    return PacketBuilder(38)
        .u16(14, 301)
        .u16(16, 1850)
        .u16(18, 19850)
        .u8(20, 50)
        .u8(21, 100)
        .u32(22, 27447297)
        .u16(26, 40001)
        .u32(28, 3);
}

Value servingCell()
{
    return makeDictionary({{"CellMonitorCellRadioAccessTechnology", "CellMonitorRadioAccessTechnologyLTE"},
                           {"CellMonitorCellType", "CellMonitorCellTypeServing"},
                           {"CellMonitorUARFCN", 6300},
                           {"CellMonitorBandInfo", 20},
                           {"CellMonitorPID", 77},
                           {"CellMonitorCellId", 12345678},
                           {"CellMonitorTAC", 4711}});
}

Value cell(const char* technology, const char* type, int trackingArea)
{
    return makeDictionary({{"CellMonitorCellRadioAccessTechnology", technology},
                           {"CellMonitorCellType", type},
                           {"CellMonitorUARFCN", 1},
                           {"CellMonitorBandInfo", 1},
                           {"CellMonitorPID", 1},
                           {"CellMonitorCellId", 1},
                           {"CellMonitorTAC", trackingArea}});
}

PacketBuilder cellList(std::vector<Value> cells)
{
    return internalPacket(makeArray(std::move(cells)));
}

class LTEServingCellInfoTest : public testing::Test {
protected:
    SectionFixture<LTEServingCellInfo> section{makeDictionary()};
};

TEST_F(LTEServingCellInfoTest, SubscribesToConfigurationThenInformationBlockThenCellMonitor)
{
    EXPECT_EQ(section.section.getSectionName(), "Serving Cell Info");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xB0C2, 0xB0C1, 0xFF0001));
}

TEST_F(LTEServingCellInfoTest, ShowsTheConfiguration)
{
    section.receive(kConfiguration, configuration());
    EXPECT_EQ(section.shown(), "Physical Cell ID: 301\n"
                               "Download Frequency: 1850\n"
                               "Upload Frequency: 19850\n"
                               "Download Bandwidth: 10 MHz\n"
                               "Upload Bandwidth: 20 MHz\n"
                               "Cell Identity: 27447297\n"
                               "Tracking Area Code: 40001\n"
                               "Freq Band Indicator: 3\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>LTE Serving Cell Info"));
}

TEST_F(LTEServingCellInfoTest, PrintsWideFieldsAsSignedAndNarrowOnesAsTheyAre)
{
    section.receive(kConfiguration, PacketBuilder(38)
                                        .u16(14, 0xFFFF)
                                        .u16(16, 0xFFFF)
                                        .u16(18, 0xFFFF)
                                        .u32(22, 0xFFFFFFFF)
                                        .u16(26, 0xFFFF)
                                        .u32(28, 0x80000000));
    EXPECT_EQ(section.shown(), "Physical Cell ID: 65535\n"
                               "Download Frequency: 65535\n"
                               "Upload Frequency: 65535\n"
                               "Download Bandwidth: Unknown\n"
                               "Upload Bandwidth: Unknown\n"
                               "Cell Identity: -1\n"
                               "Tracking Area Code: 65535\n"
                               "Freq Band Indicator: -2147483648\n");
}

TEST_F(LTEServingCellInfoTest, NamesEachBandwidthOfItsOwnCode)
{
    const std::pair<unsigned, const char*> named[] = {{6, "1.4 MHz"}, {15, "3 MHz"},  {25, "5 MHz"},
                                                      {50, "10 MHz"}, {75, "15 MHz"}, {100, "20 MHz"}};
    for (unsigned code = 0; code <= 255; ++code) {
        std::string text = "Unknown";
        for (const auto& [known, bandwidth] : named)
            if (known == code)
                text = bandwidth;
        section.receive(kConfiguration, PacketBuilder(38).u8(20, code).u8(21, 7));
        EXPECT_EQ(section.row("Download Bandwidth"), text) << code;
        EXPECT_EQ(section.row("Upload Bandwidth"), "Unknown") << code;
        section.receive(kConfiguration, PacketBuilder(38).u8(20, 6).u8(21, code));
        EXPECT_EQ(section.row("Download Bandwidth"), "1.4 MHz") << code;
        EXPECT_EQ(section.row("Upload Bandwidth"), text) << code;
    }
}

TEST_F(LTEServingCellInfoTest, NeedsThirtyEightBytesOfConfiguration)
{
    section.receive(kConfiguration, configuration().length(37));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>LTE Serving Cell Info"));
    section.receive(kConfiguration, configuration().length(38));
    EXPECT_EQ(section.row("Freq Band Indicator"), "3");
    section.receive(kConfiguration, PacketBuilder(39).u16(14, 12));
    EXPECT_EQ(section.row("Physical Cell ID"), "12");
}

TEST_F(LTEServingCellInfoTest, ShowsTheTransmitAntennasAndLogsTheCodeAsUnknownAllTheSame)
{
    section.receive(kInformationBlock, PacketBuilder(22).u8(19, 1).u8(20, 4).u8(21, 2));
    EXPECT_EQ(section.shown(), "Num Tx Antennas: 4\n");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>LTE Serving Cell Info", "<3>Received an unknown log message: 45249"));
}

TEST_F(LTEServingCellInfoTest, NeedsTwentyTwoBytesOfInformationBlock)
{
    section.receive(kInformationBlock, PacketBuilder(21).u8(20, 4));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>LTE Serving Cell Info"));
    section.receive(kInformationBlock, PacketBuilder(23).u8(20, 255));
    EXPECT_EQ(section.shown(), "Num Tx Antennas: 255\n");
}

TEST_F(LTEServingCellInfoTest, ShowsTheServingCellOfTheCellMonitor)
{
    section.receive(kCells, cellList({servingCell()}));
    EXPECT_EQ(section.shown(), "Tracking Area Code: 4711\n"
                               "Cell Identity: 12345678\n"
                               "Physical Cell ID: 77\n"
                               "Freq Band Indicator: 20\n"
                               "UARFCN: 6300\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>LTE Serving Cell Info"));
}

TEST_F(LTEServingCellInfoTest, TakesTheFirstServingLTECellOfTheList)
{
    section.receive(kCells,
                    cellList({"no cell", makeDictionary(),
                              makeDictionary({{"CellMonitorCellType", "CellMonitorCellTypeServing"}}),
                              makeDictionary({{"CellMonitorCellRadioAccessTechnology",
                                               "CellMonitorRadioAccessTechnologyLTE"}}),
                              cell("CellMonitorRadioAccessTechnologyLTE", "CellMonitorCellTypeNeighbor", 1),
                              cell("CellMonitorRadioAccessTechnologyUMTS", "CellMonitorCellTypeServing", 2),
                              cell("cellmonitorradioaccesstechnologylte", "CellMonitorCellTypeServing", 3),
                              cell("CellMonitorRadioAccessTechnologyLTE2", "CellMonitorCellTypeServing", 4),
                              cell("CellMonitorRadioAccessTechnologyLTE", "CellMonitorCellTypeServing", 5),
                              cell("CellMonitorRadioAccessTechnologyLTE", "CellMonitorCellTypeServing", 6)}));
    EXPECT_EQ(section.row("Tracking Area Code"), "5");
}

TEST_F(LTEServingCellInfoTest, IsSilentAboutAListWithoutAServingLTECell)
{
    section.receive(kConfiguration, configuration());
    const std::string before = section.shown();
    section.logged();
    section.receive(
        kCells, cellList({cell("CellMonitorRadioAccessTechnologyLTE", "CellMonitorCellTypeNeighbor", 1)}));
    section.receive(kCells, cellList({}));
    EXPECT_EQ(section.shown(), before);
    EXPECT_THAT(section.logged(), ElementsAre("<4>LTE Serving Cell Info", "<4>LTE Serving Cell Info"));
}

TEST_F(LTEServingCellInfoTest, LogsEveryNumberThatTheCellLacksAndLeavesItsRow)
{
    section.receive(kCells, cellList({servingCell()}));
    const std::string before = section.shown();
    section.logged();
    section.receive(kCells,
                    cellList({makeDictionary(
                        {{"CellMonitorCellRadioAccessTechnology", "CellMonitorRadioAccessTechnologyLTE"},
                         {"CellMonitorCellType", "CellMonitorCellTypeServing"}})}));
    EXPECT_EQ(section.shown(), before);
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>LTE Serving Cell Info", "<3>Serving Cell Info: Failed to retrieve TAC\n",
                            "<3>Serving Cell Info: Failed to retrieve Cell ID\n",
                            "<3>Serving Cell Info: Failed to retrieve Physical Cell ID\n",
                            "<3>Serving Cell Info: Failed to retrieve Freq Band Indicator\n",
                            "<3>Serving Cell Info: Failed to retrieve UARFCN\n"));
}

TEST_F(LTEServingCellInfoTest, ReadsDigitsAndWrapsAtThirtyTwoBitsButConvertsNothingElse)
{
    section.receive(kCells, cellList({makeDictionary({{"CellMonitorCellRadioAccessTechnology",
                                                       "CellMonitorRadioAccessTechnologyLTE"},
                                                      {"CellMonitorCellType", "CellMonitorCellTypeServing"},
                                                      {"CellMonitorTAC", "-12"},
                                                      {"CellMonitorCellId", Value(std::int64_t{4294967295})},
                                                      {"CellMonitorPID", "12a"},
                                                      {"CellMonitorBandInfo", true},
                                                      {"CellMonitorUARFCN", makeArray()}})}));
    EXPECT_EQ(section.shown(), "Tracking Area Code: -12\nCell Identity: -1\n");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>LTE Serving Cell Info",
                            "<3>Serving Cell Info: Failed to retrieve Physical Cell ID\n",
                            "<3>Serving Cell Info: Failed to retrieve Freq Band Indicator\n",
                            "<3>Serving Cell Info: Failed to retrieve UARFCN\n"));
}

TEST_F(LTEServingCellInfoTest, LogsAListThatCannotBeRead)
{
    for (const std::size_t length : {0, 12, 13, 20}) {
        section.receive(kCells, PacketBuilder(length));
        EXPECT_THAT(section.logged(), ElementsAre("<4>LTE Serving Cell Info",
                                                  "<3>Cell Info Array data could not be constructed",
                                                  "<3>Failed to get Cell Array\n"));
    }
    EXPECT_EQ(section.shown(), "");
}

TEST_F(LTEServingCellInfoTest, LogsAPayloadThatIsNoList)
{
    section.receive(kCells, internalPacket(servingCell()));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>LTE Serving Cell Info", "<3>Failed to get Cell Array\n"));
}

TEST_F(LTEServingCellInfoTest, DropsTheFrequencyOfTheMonitorWithEveryConfigurationUntilTheNextList)
{
    section.receive(kCells, cellList({servingCell()}));
    EXPECT_EQ(section.row("UARFCN"), "6300");
    section.receive(kConfiguration, configuration().length(37));
    EXPECT_EQ(section.row("UARFCN"), "6300");
    section.receive(kConfiguration, configuration());
    EXPECT_EQ(section.row("UARFCN"), "(none)");
    EXPECT_EQ(section.row("Tracking Area Code"), "40001");
    section.receive(kCells, cellList({servingCell()}));
    EXPECT_EQ(section.row("UARFCN"), "6300");
    EXPECT_EQ(section.row("Tracking Area Code"), "4711");
    EXPECT_EQ(section.row("Download Frequency"), "1850");
}

TEST_F(LTEServingCellInfoTest, LogsAForeignCodeAndChangesNothing)
{
    section.receive(0xB0C3, configuration());
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>LTE Serving Cell Info", "<3>Received an unknown log message: 45251"));
}

} // namespace
} // namespace pelorus::test
