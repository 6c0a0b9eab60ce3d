#include "LogGenerator/Osprey/LTE/ReselectionCandidatesMisc.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

class ReselectionCandidatesMiscTest : public testing::Test {
protected:
    SectionFixture<ReselectionCandidatesMisc> section{makeDictionary()};
};

TEST_F(ReselectionCandidatesMiscTest, SubscribesToTheReselectionCandidates)
{
    EXPECT_EQ(section.section.getSectionName(), "Reselection Candidates");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xB186));
}

TEST_F(ReselectionCandidatesMiscTest, ShowsEveryRowInTableOrder)
{
    section.receive(0xB186, PacketBuilder(21).u8(13, 2).u8(14, 255).u16(15, 1850).u16(17, 301).u16(19, 9));
    EXPECT_EQ(section.shown(), "Version: 2\n"
                               "Serving EARFCN: 1850\n"
                               "Serving Cell ID: 301\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Reselection Candidates"));
    section.receive(0xB186, PacketBuilder(21).u8(13, 255).u16(15, 65535).u16(17, 65535));
    EXPECT_EQ(section.shown(), "Version: 255\n"
                               "Serving EARFCN: 65535\n"
                               "Serving Cell ID: 65535\n");
}

TEST_F(ReselectionCandidatesMiscTest, NeedsTwentyOneBytes)
{
    section.receive(0xB186, PacketBuilder(20).u8(13, 4));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Reselection Candidates"));
    section.receive(0xB186, PacketBuilder(21).u8(13, 4));
    section.receive(0xB186, PacketBuilder(20).u8(13, 5));
    EXPECT_EQ(section.row("Version"), "4");
    section.receive(0xB186, PacketBuilder(22).u8(13, 6));
    EXPECT_EQ(section.row("Version"), "6");
}

TEST_F(ReselectionCandidatesMiscTest, LogsAForeignCodeAndChangesNothing)
{
    section.receive(0xB187, PacketBuilder(21));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Reselection Candidates", "<3>Received an unknown log message: 45447"));
}

} // namespace
} // namespace pelorus::test
