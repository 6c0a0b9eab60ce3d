#include "LogGenerator/Osprey/UTRAN/RRC_State.h"

#include "platform/Console.h"
#include "tests/support/HostilePackets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

class RRC_StateTest : public testing::Test {
protected:
    ~RRC_StateTest() override { setConsole(nullptr); }

    void listenToTheConsole()
    {
        setConsole([this](std::string_view line) { consoleLines.emplace_back(line); });
    }

    SectionFixture<RRC_State> section{makeDictionary()};
    std::vector<std::string> consoleLines;
};

TEST_F(RRC_StateTest, SubscribesToTheRadioResourceState)
{
    EXPECT_EQ(section.section.getSectionName(), "RRC Info");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xD0E0));
}

TEST_F(RRC_StateTest, NamesEveryMode)
{
    const char* const modes[] = {"Disconnected", "Connecting", "Cell Fach",
                                 "Cell DCH",     "Cell PCH",   "Cell URA PCH"};
    for (unsigned mode = 0; mode < 256; ++mode) {
        section.receive(0xD0E0, PacketBuilder(15).u8(13, 1).u8(14, mode));
        EXPECT_EQ(section.shown(),
                  std::string("State: ") + (mode < 6 ? modes[mode] : "Unknown RRC Mode") + "\n")
            << mode;
    }
    section.logged();
    section.receive(0xD0E0, PacketBuilder(15).u8(13, 1).u8(14, 3));
    EXPECT_THAT(section.logged(), ElementsAre("<4>RRC Info"));
}

TEST_F(RRC_StateTest, KnowsNoModeOfOtherVersions)
{
    for (const unsigned version : {0U, 2U, 255U}) {
        section.receive(0xD0E0, PacketBuilder(15).u8(13, 1).u8(14, 3));
        EXPECT_EQ(section.row("State"), "Cell DCH");
        section.receive(0xD0E0, PacketBuilder(15).u8(13, version).u8(14, 3));
        EXPECT_EQ(section.row("State"), "Unknown RRC Mode") << version;
    }
}

TEST_F(RRC_StateTest, WarnsOfAShortPacketAndReadsWhatIsMissingAsZero)
{
    section.receive(0xD0E0, PacketBuilder(14).u8(13, 1));
    EXPECT_EQ(section.row("State"), "Disconnected");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>RRC Info", "<4>LogCode_0xD0E0 is length is 14 expected size 15"));
    section.receive(0xD0E0, PacketBuilder(13));
    EXPECT_EQ(section.row("State"), "Unknown RRC Mode");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>RRC Info", "<4>LogCode_0xD0E0 is length is 13 expected size 15"));
    section.receive(0xD0E0, PacketBuilder());
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>RRC Info", "<4>LogCode_0xD0E0 is length is 0 expected size 15"));
    section.receive(0xD0E0, PacketBuilder(16).u8(13, 1).u8(14, 5));
    EXPECT_EQ(section.row("State"), "Cell URA PCH");
    EXPECT_THAT(section.logged(), ElementsAre("<4>RRC Info"));
}

TEST_F(RRC_StateTest, IgnoresOtherCodes)
{
    section.receive(0xD0E2, PacketBuilder(15).u8(13, 1));
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(), ElementsAre("<4>RRC Info"));
}

TEST_F(RRC_StateTest, TellsTheConsoleTheRowsAndTheMode)
{
    listenToTheConsole();
    section.receive(0xD0E0, PacketBuilder(15).u8(13, 1).u8(14, 3));
    section.receive(0xD0E0, PacketBuilder(15).u8(13, 2).u8(14, 3));
    section.entry.dictionary()->set("Note", "a");
    section.receive(0xD0E0, PacketBuilder(14).u8(13, 1));
    section.receive(0xD0E1, PacketBuilder(15));
    EXPECT_THAT(consoleLines,
                ElementsAre("Display Dict = {State = Cell DCH}, rrc mode = 3 Cell DCH",
                            "Display Dict = {State = Unknown RRC Mode}, rrc mode = 255 Unknown RRC Mode",
                            "Display Dict = {State = Disconnected; Note = a}, rrc mode = 0 Disconnected"));
}

TEST_F(RRC_StateTest, ShowsAStateForEveryPrefix)
{
    forEachPrefix(PacketBuilder(15).u8(13, 1).u8(14, 4).bytes(), [this](const LogPacket& packet) {
        section.section.updateWithData(packet, 0xD0E0);
        EXPECT_EQ(section.row("State"), packet.size() < 14    ? "Unknown RRC Mode"
                                        : packet.size() == 14 ? "Disconnected"
                                                              : "Cell PCH");
    });
}

} // namespace
} // namespace pelorus::test
