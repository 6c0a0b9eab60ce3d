#include "LogGenerator/Osprey/GSM/PDPContextList.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

PacketBuilder twoContexts()
{
    return internalPacket(makeArray(
        {makeDictionary({{"APN", "internet"}, {"Address", "10.0.0.7"}}), makeDictionary({{"APN", "mms"}})}));
}

constexpr const char* kTwoContexts = "-\n"
                                     "  APN: internet\n"
                                     "  Address: 10.0.0.7\n"
                                     "-\n"
                                     "  APN: mms\n";

TEST(PDPContextList, ShowsTheContextsAsTheyWereSent)
{
    SectionFixture<PDPContextList> section(makeArray({"old"}));
    section.receive(0xFF0002, twoContexts());
    EXPECT_EQ(section.shown(), kTwoContexts);
    EXPECT_THAT(section.logged(), ElementsAre("<4>PDPContextList"));
    EXPECT_EQ(section.section.getSectionName(), "PDP Context Info");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xFF0002));
}

TEST(PDPContextList, ShowsOnlyTheLastList)
{
    SectionFixture<PDPContextList> section(makeArray());
    section.receive(0xFF0002, twoContexts());
    section.receive(0xFF0002, internalPacket(makeArray({makeDictionary({{"APN", "mms"}}), "text", 5})));
    EXPECT_EQ(section.entry, Value(makeArray({makeDictionary({{"APN", "mms"}}), "text", 5})));
    section.receive(0xFF0002, internalPacket(makeArray()));
    EXPECT_EQ(section.shown(), "");
}

TEST(PDPContextList, IsNotChangedByAPayloadThatIsNoList)
{
    SectionFixture<PDPContextList> section(makeArray());
    section.receive(0xFF0002, twoContexts());
    section.logged();
    section.receive(0xFF0002, internalPacket(makeDictionary({{"APN", "mms"}})));
    section.receive(0xFF0002, PacketBuilder(40).u8(0, 0xFF));
    section.receive(0xFF0002, PacketBuilder(13));
    section.receive(0xFF0002, PacketBuilder(12));
    section.receive(0xFF0002, PacketBuilder(11));
    EXPECT_EQ(section.shown(), kTwoContexts);
    EXPECT_THAT(section.logged(), ElementsAre("<4>PDPContextList", "<4>PDPContextList", "<4>PDPContextList",
                                              "<4>PDPContextList", "<4>PDPContextList"));
}

TEST(PDPContextList, DoesNotLookAtTheCode)
{
    SectionFixture<PDPContextList> section(makeArray());
    section.receive(0x1234, twoContexts());
    EXPECT_EQ(section.shown(), kTwoContexts);
}

} // namespace
} // namespace pelorus::test
