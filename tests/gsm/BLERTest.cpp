#include "LogGenerator/Osprey/GSM/BLER.h"
#include "tests/gsm/Packets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

constexpr const char* kFirstChannel = "Window Size: 500\n"
                                      "Transport Channels:\n"
                                      "  -\n"
                                      "    Transport Channel ID: 1\n"
                                      "    CRC Received: 4000\n"
                                      "    CRC Received in Error: 25\n";

TEST(BLER, ShowsTheWindowAndTheChannels)
{
    SectionFixture<BLER> section(makeDictionary());
    section.receive(0x4116, blockErrors());
    EXPECT_EQ(section.shown(), std::string(kFirstChannel) + "  -\n"
                                                            "    Transport Channel ID: 255\n"
                                                            "    CRC Received: 2147483647\n"
                                                            "    CRC Received in Error: -2147483648\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>BLER"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x4116));
}

TEST(BLER, ShowsAnEmptyListForACountOfNone)
{
    SectionFixture<BLER> section(makeDictionary());
    section.receive(0x4116, blockErrors());
    section.receive(0x4116, PacketBuilder(34).u16(14, 65535));
    EXPECT_EQ(section.shown(), "Window Size: 65535\nTransport Channels:\n");
    EXPECT_TRUE(section.entry.dictionary()->at("Transport Channels").array());
}

TEST(BLER, KeepsItsRowsWhenThePacketIsOneByteShort)
{
    SectionFixture<BLER> section(makeDictionary());
    section.receive(0x4116, blockErrors().u8(13, 1));
    section.receive(0x4116, PacketBuilder(15));
    EXPECT_EQ(section.shown(), kFirstChannel);
}

TEST(BLER, DropsChannelsThatAreNotWhollyInThePacket)
{
    SectionFixture<BLER> section(makeDictionary());
    section.receive(0x4116, blockErrors().length(33));
    EXPECT_EQ(section.shown(), kFirstChannel);
    section.receive(0x4116, blockErrors().length(24));
    EXPECT_EQ(section.shown(), "Window Size: 500\nTransport Channels:\n");
    section.receive(0x4116, blockErrors().u8(13, 255));
    EXPECT_EQ(section.entry.dictionary()->at("Transport Channels").array()->elements.size(), 2U);
}

} // namespace
} // namespace pelorus::test
