#include "LogGenerator/Osprey/GSM/EquivalentPLMNList.h"
#include "tests/gsm/Packets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

TEST(EquivalentPLMNList, ReadsSixInterleavedDigitsEveryThreeBytes)
{
    SectionFixture<EquivalentPLMNList> section(makeArray());
    section.receive(0x7150, equivalentNetworks());
    EXPECT_EQ(section.shown(), "-\n  Mobile Country Code: 310\n  Mobile Network Code: 260\n"
                               "-\n  Mobile Country Code: 605\n  Mobile Network Code: 47\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Equivalent PLMN List"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x7150));
}

TEST(EquivalentPLMNList, DropsLeadingZeros)
{
    SectionFixture<EquivalentPLMNList> section(makeArray());
    section.receive(0x7150, PacketBuilder(23).u8(16, 1).u8(21, 1).u8(22, 0));
    EXPECT_EQ(section.shown(), "-\n  Mobile Country Code: 1\n  Mobile Network Code: 0\n");
}

TEST(EquivalentPLMNList, UsesBytesThatAreNoDigitsAsTheyAre)
{
    SectionFixture<EquivalentPLMNList> section(makeArray());
    section.receive(0x7150, PacketBuilder(23).u8(16, 1).u32(17, 0xFFFFFFFF).u16(21, 0xFFFF));
    EXPECT_EQ(section.shown(), "-\n  Mobile Country Code: 28305\n  Mobile Network Code: 28305\n");
}

TEST(EquivalentPLMNList, IsEmptiedByACountOfNone)
{
    SectionFixture<EquivalentPLMNList> section(makeArray());
    section.receive(0x7150, equivalentNetworks());
    section.receive(0x7150, PacketBuilder(26));
    EXPECT_EQ(section.shown(), "");
}

TEST(EquivalentPLMNList, KeepsItsRowsWhenThePacketIsOneByteShort)
{
    SectionFixture<EquivalentPLMNList> section(makeArray());
    section.receive(0x7150, equivalentNetworks());
    section.receive(0x7150, PacketBuilder(16));
    EXPECT_EQ(section.rowCount(), 2U);
}

TEST(EquivalentPLMNList, DropsANetworkThatIsNotWhollyInThePacket)
{
    SectionFixture<EquivalentPLMNList> section(makeArray());
    section.receive(0x7150, equivalentNetworks().length(25));
    EXPECT_EQ(section.shown(), "-\n  Mobile Country Code: 310\n  Mobile Network Code: 260\n");
    section.receive(0x7150, equivalentNetworks().length(22));
    EXPECT_EQ(section.shown(), "");
    section.receive(0x7150, equivalentNetworks().u8(16, 255));
    EXPECT_EQ(section.rowCount(), 2U);
}

TEST(EquivalentPLMNList, ShowsAllOf255Networks)
{
    SectionFixture<EquivalentPLMNList> section(makeArray());
    section.receive(0x7150, PacketBuilder(17 + 3 * 254 + 6).u8(16, 255).u8(17 + 3 * 254, 9));
    EXPECT_EQ(section.rowCount(), 255U);
    EXPECT_EQ(textOf(section.entry.array()->elements[254]),
              "Mobile Country Code: 900\nMobile Network Code: 0\n");
}

} // namespace
} // namespace pelorus::test
