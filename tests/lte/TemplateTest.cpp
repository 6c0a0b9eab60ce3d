#include "tests/support/TemplateFixture.h"

#include "LogGenerator/Osprey/LTE/LTELogGenerator.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

constexpr const char* kKeyedSections[] = {
    "Serving Cell Info",     "Serving Cell Measurements", "Connected mode LTE Intra-frequency Measurement",
    "Neighbor Measurements", "Reselection Candidates",    "SIM Info"};
constexpr const char* kListSections[] = {"Measured Neighbor Cells", "Detected Cells", "Neighbor Cells List",
                                         "Reselection Candidates List", "PDP Context Info"};

class LTETemplate : public testing::Test {
protected:
    void receiveEverything()
    {
        fixture.receive(0xB0C2, PacketBuilder(38));
        fixture.receive(0xB0C1, PacketBuilder(22));
        fixture.receive(0xB179, PacketBuilder(29 + 6 + 2).u8(27, 1).u8(28, 1));
        fixture.receive(0xB17F, PacketBuilder(33));
        fixture.receive(0xB180, PacketBuilder(41));
        fixture.receive(0xB186, PacketBuilder(25).u16(19, 1));
        fixture.receive(0xFF0000, allSimFiles());
        fixture.receive(0xFF0001,
                        internalPacket(makeArray({makeDictionary(
                            {{"CellMonitorCellRadioAccessTechnology", "CellMonitorRadioAccessTechnologyLTE"},
                             {"CellMonitorCellType", "CellMonitorCellTypeServing"},
                             {"CellMonitorTAC", 1},
                             {"CellMonitorCellId", 2},
                             {"CellMonitorPID", 3},
                             {"CellMonitorBandInfo", 4},
                             {"CellMonitorUARFCN", 5}})})));
        fixture.receive(0xFF0002, internalPacket(makeArray({makeDictionary({{"APN", "internet"}})})));
    }

    TemplateFixture<LTELogGenerator> fixture{"LTE"};
};

TEST_F(LTETemplate, HoldsEachSectionOnceAsTheKindThatItFills)
{
    for (const char* section : kKeyedSections) {
        EXPECT_EQ(fixture.occurrences(fixture.pattern(), section), 1U) << section;
        EXPECT_TRUE(fixture.valueOf(fixture.pattern(), section).dictionary()) << section;
    }
    for (const char* section : kListSections) {
        EXPECT_EQ(fixture.occurrences(fixture.pattern(), section), 1U) << section;
        ASSERT_TRUE(fixture.valueOf(fixture.pattern(), section).array()) << section;
        EXPECT_TRUE(fixture.valueOf(fixture.pattern(), section).array()->elements.empty()) << section;
    }
}

TEST_F(LTETemplate, GroupsTheSectionsInAnOrderOfItsOwn)
{
    EXPECT_THAT(fixture.labels(fixture.pattern()),
                ElementsAre("_sorted", "01;Serving cell", "02;Measurements", "03;Neighbor cells",
                            "04;Reselection", "05;SIM", "06;Data"));
    EXPECT_THAT(fixture.fileText(), Not(HasSubstr("DOCTYPE")));
}

TEST_F(LTETemplate, ListsTheRowsOfTheServingCellInTheOrderInWhichTheyAreWritten)
{
    EXPECT_THAT(fixture.labels(fixture.valueOf(fixture.pattern(), "Serving Cell Info")),
                ElementsAre("Physical Cell ID", "Download Frequency", "Upload Frequency",
                            "Download Bandwidth", "Upload Bandwidth", "Cell Identity", "Tracking Area Code",
                            "Freq Band Indicator", "Num Tx Antennas", "UARFCN"));
}

TEST_F(LTETemplate, ListsExactlyTheRowsThatTheSectionsWrite)
{
    for (const char* section : kKeyedSections)
        EXPECT_EQ(fixture.labels(fixture.shown(section)), fixture.unwritten(fixture.shown(section)))
            << section << " starts with something other than placeholders";
    fixture.receive(0xB0C2, PacketBuilder(37)); // too short for any row
    receiveEverything();
    for (const char* section : kKeyedSections) {
        EXPECT_EQ(fixture.labels(fixture.shown(section)),
                  fixture.labels(fixture.valueOf(fixture.pattern(), section)))
            << section;
        EXPECT_THAT(fixture.unwritten(fixture.shown(section)), IsEmpty()) << section;
    }
    for (const char* section : kListSections)
        EXPECT_EQ(fixture.shown(section).array()->elements.size(), 1U) << section;
}

} // namespace
} // namespace pelorus::test
