#include "LogGenerator/Osprey/GSM/MobileAllocation.h"
#include "tests/gsm/Packets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

TEST(MobileAllocation, ShowsTheSequenceNumberAndTheChannels)
{
    SectionFixture<MobileAllocation> section(makeDictionary());
    section.receive(0x51F8, hoppingChannels());
    EXPECT_EQ(section.shown(), "HSN: 63\n"
                               "ARFCNs:\n"
                               "  - 1\n"
                               "  - 1023\n"
                               "  - 65535\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>MobileAllocation"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x51F8));
}

TEST(MobileAllocation, ReplacesTheChannelsWhole)
{
    SectionFixture<MobileAllocation> section(makeDictionary());
    section.receive(0x51F8, hoppingChannels());
    section.receive(0x51F8, PacketBuilder(17).u8(13, 1).u8(14, 1).u16(15, 512));
    EXPECT_EQ(section.shown(), "HSN: 1\nARFCNs:\n  - 512\n");
    section.receive(0x51F8, PacketBuilder(15));
    EXPECT_EQ(section.shown(), "HSN: 0\nARFCNs:\n");
    EXPECT_TRUE(section.entry.dictionary()->at("ARFCNs").array());
}

TEST(MobileAllocation, DropsChannelsThatAreNotWhollyInThePacket)
{
    SectionFixture<MobileAllocation> section(makeDictionary());
    section.receive(0x51F8, hoppingChannels().length(20));
    EXPECT_EQ(section.shown(), "HSN: 63\nARFCNs:\n  - 1\n  - 1023\n");
    section.receive(0x51F8, hoppingChannels().length(16));
    EXPECT_EQ(section.shown(), "HSN: 63\nARFCNs:\n");
    section.receive(0x51F8, hoppingChannels().u8(14, 255));
    EXPECT_EQ(section.shown(), "HSN: 63\nARFCNs:\n  - 1\n  - 1023\n  - 65535\n");
}

TEST(MobileAllocation, MakesAListWhereTheDisplayHasAText)
{
    SectionFixture<MobileAllocation> section(makeDictionary({{"ARFCNs", "-"}, {"HSN", "-"}}));
    section.receive(0x51F8, hoppingChannels().u8(14, 1));
    EXPECT_EQ(section.shown(), "ARFCNs:\n  - 1\nHSN: 63\n");
}

} // namespace
} // namespace pelorus::test
