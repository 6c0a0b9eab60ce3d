#include "LogGenerator/Osprey/UTRAN/UTRANServingCellInfo.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

constexpr LogCode kCells = 0xFF0001;

PacketBuilder fullPacket()
{
    return PacketBuilder(26).u8(14, 2).u8(15, 200).u16(17, 9763).u16(19, 10713).u32(21, 54321098).u8(25, 1);
}

Value cell(const char* technology, const char* type, int areaCode)
{
    return makeDictionary({{"CellMonitorCellRadioAccessTechnology", technology},
                           {"CellMonitorCellType", type},
                           {"CellMonitorLAC", areaCode},
                           {"CellMonitorCellId", 100 + areaCode},
                           {"CellMonitorBandInfo", 200 + areaCode},
                           {"CellMonitorSCN", 300 + areaCode},
                           {"CellMonitorUARFCN", 400 + areaCode}});
}

Value servingCell(int areaCode)
{
    return cell("CellMonitorRadioAccessTechnologyUTRAN2", "CellMonitorCellTypeServing", areaCode);
}

PacketBuilder cellList(std::vector<Value> cells)
{
    return internalPacket(makeArray(std::move(cells)));
}

class UTRANServingCellInfoTest : public testing::Test {
protected:
    SectionFixture<UTRANServingCellInfo> section{makeDictionary()};
};

TEST_F(UTRANServingCellInfoTest, SubscribesToTheServingCellThenToTheCellMonitor)
{
    EXPECT_EQ(section.section.getSectionName(), "Serving Cell Info");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xD0E2, 0xFF0001));
}

TEST_F(UTRANServingCellInfoTest, ShowsEveryRowInTableOrder)
{
    section.receive(0xD0E2, fullPacket());
    EXPECT_EQ(section.shown(), "Cell Access Restrictions: 2\n"
                               "Cell ID: 54321098\n"
                               "Downlink UARFCN: 10713\n"
                               "Uplink UARFCN: 9763\n"
                               "URA ID: 200\n"
                               "Allowed Access: Emergency Calls Only\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving Cell Info"));
}

TEST_F(UTRANServingCellInfoTest, PrintsTheCellIdentityAsSigned)
{
    section.receive(
        0xD0E2, PacketBuilder(26).u8(14, 255).u8(15, 255).u16(17, 65535).u16(19, 65535).u32(21, 0xFFFFFFFE));
    EXPECT_EQ(section.shown(), "Cell Access Restrictions: 255\n"
                               "Cell ID: -2\n"
                               "Downlink UARFCN: 65535\n"
                               "Uplink UARFCN: 65535\n"
                               "URA ID: 255\n"
                               "Allowed Access: All Calls\n");
}

TEST_F(UTRANServingCellInfoTest, TellsTheAllowedAccessByOneBit)
{
    section.receive(0xD0E2, PacketBuilder(26).u8(25, 0x03));
    EXPECT_EQ(section.row("Allowed Access"), "Emergency Calls Only");
    section.receive(0xD0E2, PacketBuilder(26).u8(25, 0x02));
    EXPECT_EQ(section.row("Allowed Access"), "All Calls");
    section.receive(0xD0E2, PacketBuilder(26).u8(25, 0xFF));
    EXPECT_EQ(section.row("Allowed Access"), "Emergency Calls Only");
    section.receive(0xD0E2, PacketBuilder(26).u8(25, 0xFE));
    EXPECT_EQ(section.row("Allowed Access"), "All Calls");
}

TEST_F(UTRANServingCellInfoTest, NeedsTwentySixBytes)
{
    section.receive(0xD0E2, fullPacket().length(25));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving Cell Info"));
    section.receive(0xD0E2, fullPacket());
    section.receive(0xD0E2, PacketBuilder(25));
    EXPECT_EQ(section.row("URA ID"), "200");
    section.receive(0xD0E2, PacketBuilder(27).u8(15, 7));
    EXPECT_EQ(section.row("URA ID"), "7");
}

TEST_F(UTRANServingCellInfoTest, ShowsTheServingCellOfTheCellMonitor)
{
    section.receive(kCells, cellList({servingCell(1)}));
    EXPECT_EQ(section.shown(), "Local Area Code: 1\n"
                               "Cell ID: 101\n"
                               "Freq Band Indicator: 201\n"
                               "Cell Scrambling Code: 301\n"
                               "Uplink UARFCN: 401\n"
                               "Downlink UARFCN: 401\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving Cell Info"));
}

TEST_F(UTRANServingCellInfoTest, ShowsTheLatestOfBothSources)
{
    section.receive(0xD0E2, fullPacket());
    section.receive(kCells, cellList({servingCell(1)}));
    EXPECT_EQ(section.shown(), "Cell Access Restrictions: 2\n"
                               "Cell ID: 101\n"
                               "Downlink UARFCN: 401\n"
                               "Uplink UARFCN: 401\n"
                               "URA ID: 200\n"
                               "Allowed Access: Emergency Calls Only\n"
                               "Local Area Code: 1\n"
                               "Freq Band Indicator: 201\n"
                               "Cell Scrambling Code: 301\n");
    section.receive(0xD0E2, fullPacket());
    EXPECT_EQ(section.row("Cell ID"), "54321098");
    EXPECT_EQ(section.row("Downlink UARFCN"), "10713");
    EXPECT_EQ(section.row("Uplink UARFCN"), "9763");
    EXPECT_EQ(section.row("Local Area Code"), "1");
}

TEST_F(UTRANServingCellInfoTest, TheLastServingCellOfTheListWins)
{
    section.receive(
        kCells,
        cellList({"no cell", makeDictionary(),
                  makeDictionary({{"CellMonitorCellType", "CellMonitorCellTypeServing"}}), servingCell(1),
                  makeDictionary(
                      {{"CellMonitorCellRadioAccessTechnology", "CellMonitorRadioAccessTechnologyUTRAN2"},
                       {"CellMonitorCellType", "CellMonitorCellTypeServing"},
                       {"CellMonitorLAC", 2},
                       {"CellMonitorSCN", 302}}),
                  cell("CellMonitorRadioAccessTechnologyUTRAN2", "CellMonitorCellTypeNeighbor", 3),
                  cell("CellMonitorRadioAccessTechnologyUMTS", "CellMonitorCellTypeServing", 4),
                  makeDictionary(
                      {{"CellMonitorCellRadioAccessTechnology", "CellMonitorRadioAccessTechnologyUTRAN2"},
                       {"CellMonitorLAC", 5}})}));
    EXPECT_EQ(section.shown(), "Local Area Code: 2\n"
                               "Cell ID: 101\n"
                               "Freq Band Indicator: 201\n"
                               "Cell Scrambling Code: 302\n"
                               "Uplink UARFCN: 401\n"
                               "Downlink UARFCN: 401\n");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Serving Cell Info", "<3>Serving Cell Info: Failed to retrieve Cell ID\n",
                            "<3>Serving Cell Info: Failed to retrieve Freq Band Indicator\n",
                            "<3>Serving Cell Info: Failed to retrieve UARFCN\n"));
}

TEST_F(UTRANServingCellInfoTest, IsSilentAboutAListWithoutAServingUTRANCell)
{
    section.receive(0xD0E2, fullPacket());
    const std::string before = section.shown();
    section.logged();
    section.receive(
        kCells, cellList({cell("CellMonitorRadioAccessTechnologyUTRAN2", "CellMonitorCellTypeNeighbor", 3)}));
    section.receive(kCells, cellList({}));
    EXPECT_EQ(section.shown(), before);
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving Cell Info", "<4>Serving Cell Info"));
}

TEST_F(UTRANServingCellInfoTest, LogsEveryNumberThatTheCellLacksAndLeavesItsRow)
{
    section.receive(kCells, cellList({servingCell(1)}));
    const std::string before = section.shown();
    section.logged();
    section.receive(kCells, cellList({makeDictionary({{"CellMonitorCellRadioAccessTechnology",
                                                       "CellMonitorRadioAccessTechnologyUTRAN2"},
                                                      {"CellMonitorCellType", "CellMonitorCellTypeServing"},
                                                      {"CellMonitorUARFCN", 1.5},
                                                      {"CellMonitorSCN", "none"}})}));
    EXPECT_EQ(section.shown(), before);
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Serving Cell Info", "<3>Serving Cell Info: Failed to retrieve LAC\n",
                            "<3>Serving Cell Info: Failed to retrieve Cell ID\n",
                            "<3>Serving Cell Info: Failed to retrieve Freq Band Indicator\n",
                            "<3>Serving Cell Info: Failed to retrieve Cell Scrambling Code\n",
                            "<3>Serving Cell Info: Failed to retrieve UARFCN\n"));
}

TEST_F(UTRANServingCellInfoTest, SetsTheFrequenciesOfACellWithoutAScramblingCode)
{
    section.receive(kCells, cellList({makeDictionary({{"CellMonitorCellRadioAccessTechnology",
                                                       "CellMonitorRadioAccessTechnologyUTRAN2"},
                                                      {"CellMonitorCellType", "CellMonitorCellTypeServing"},
                                                      {"CellMonitorLAC", "-7"},
                                                      {"CellMonitorCellId", Value(std::int64_t{4294967295})},
                                                      {"CellMonitorBandInfo", 1},
                                                      {"CellMonitorUARFCN", 10713}})}));
    EXPECT_EQ(section.shown(), "Local Area Code: -7\n"
                               "Cell ID: -1\n"
                               "Freq Band Indicator: 1\n"
                               "Uplink UARFCN: 10713\n"
                               "Downlink UARFCN: 10713\n");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Serving Cell Info",
                            "<3>Serving Cell Info: Failed to retrieve Cell Scrambling Code\n"));
}

TEST_F(UTRANServingCellInfoTest, LogsOneLineForAListThatCannotBeRead)
{
    for (const std::size_t length : {0, 12, 13, 20}) {
        section.receive(kCells, PacketBuilder(length));
        EXPECT_THAT(section.logged(),
                    ElementsAre("<4>Serving Cell Info", "<3>Cell Info Array data could not be constructed"));
    }
    EXPECT_EQ(section.shown(), "");
}

TEST_F(UTRANServingCellInfoTest, IsSilentAboutAPayloadThatIsNoList)
{
    section.receive(kCells, internalPacket(servingCell(1)));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving Cell Info"));
}

TEST_F(UTRANServingCellInfoTest, IgnoresOtherCodes)
{
    section.receive(0xD0E0, fullPacket());
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving Cell Info"));
}

} // namespace
} // namespace pelorus::test
