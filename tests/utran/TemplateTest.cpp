#include "tests/support/TemplateFixture.h"

#include "LogGenerator/Osprey/UTRAN/UTRANLogGenerator.h"
#include "tests/utran/Sections.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

class UTRANTemplate : public testing::Test {
protected:
    void receiveEverything()
    {
        fixture.receive(0xD0E0, PacketBuilder(15).u8(13, 1));
        fixture.receive(0xD0E2, PacketBuilder(26));
        fixture.receive(0xD00A, PacketBuilder(184).u8(16, 2));
        fixture.receive(0xD00E, PacketBuilder(25).u8(16, 1));
        fixture.receive(0xD00C, PacketBuilder(289 + 34 + 8).u16(14, 1 << 12 | 1 << 6));
        fixture.receive(0xFF0000, allSimFiles());
        fixture.receive(
            0xFF0001, internalPacket(makeArray({makeDictionary(
                          {{"CellMonitorCellRadioAccessTechnology", "CellMonitorRadioAccessTechnologyUTRAN2"},
                           {"CellMonitorCellType", "CellMonitorCellTypeServing"},
                           {"CellMonitorLAC", 1},
                           {"CellMonitorCellId", 2},
                           {"CellMonitorBandInfo", 3},
                           {"CellMonitorSCN", 4},
                           {"CellMonitorUARFCN", 5}})})));
        fixture.receive(0xFF0002, internalPacket(makeArray({makeDictionary({{"APN", "internet"}})})));
    }

    TemplateFixture<UTRANLogGenerator> fixture{"UTRAN"};
};

TEST_F(UTRANTemplate, HoldsEachSectionOnceAsTheKindThatItFills)
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

TEST_F(UTRANTemplate, GroupsTheSectionsInAnOrderOfItsOwn)
{
    EXPECT_THAT(fixture.labels(fixture.pattern()),
                ElementsAre("_sorted", "01;Serving cell", "02;Neighbor cells", "03;Transport channels",
                            "04;SIM", "05;Data"));
    EXPECT_THAT(fixture.fileText(), Not(HasSubstr("DOCTYPE")));
}

TEST_F(UTRANTemplate, ListsTheRowsOfTheServingCellInTheOrderInWhichTheyAreWritten)
{
    EXPECT_THAT(fixture.labels(fixture.valueOf(fixture.pattern(), "Serving Cell Info")),
                ElementsAre("Cell Access Restrictions", "Cell ID", "Downlink UARFCN", "Uplink UARFCN",
                            "URA ID", "Allowed Access", "Local Area Code", "Freq Band Indicator",
                            "Cell Scrambling Code"));
}

TEST_F(UTRANTemplate, ListsExactlyTheRowsThatTheSectionsWrite)
{
    for (const char* section : kKeyedSections)
        EXPECT_EQ(fixture.labels(fixture.shown(section)), fixture.unwritten(fixture.shown(section)))
            << section << " starts with something other than placeholders";
    receiveEverything();
    for (const char* section : kKeyedSections) {
        EXPECT_EQ(fixture.labels(fixture.shown(section)),
                  fixture.labels(fixture.valueOf(fixture.pattern(), section)))
            << section;
        EXPECT_THAT(fixture.unwritten(fixture.shown(section)), IsEmpty()) << section;
    }
    for (const char* section : kListSections) // the GSM neighbours are never shown: meant
        EXPECT_EQ(fixture.shown(section).array()->elements.size(),
                  std::string_view(section) == "GSM Neighbor Cell List" ? 0U : 1U)
            << section;
}

} // namespace
} // namespace pelorus::test
