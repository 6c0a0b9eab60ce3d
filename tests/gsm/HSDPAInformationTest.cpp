#include "LogGenerator/Osprey/GSM/HSDPAInformation.h"
#include "tests/gsm/Packets.h"
#include "tests/gsm/ShownText.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

constexpr const char* kPrimary = "Primary HARQ Process:\n"
                                 "  -\n"
                                 "    Process ID: 4\n"
                                 "    No Rx Bits: 70000\n"
                                 "    New Tx: 300\n"
                                 "    Block Errors: 12\n";
constexpr const char* kFirstSecondary = "Secondary HARQ Process:\n"
                                        "  -\n"
                                        "    Process ID: 5\n"
                                        "    No Rx Bits: 4294967295\n"
                                        "    New Tx: 65535\n"
                                        "    Block Errors: 40000\n";

TEST(HSDPAInformation, ShowsBothListsWithTheSecondOne162BytesFurtherOn)
{
    SectionFixture<HSDPAInformation> section(makeDictionary());
    section.receive(0x4221, harqProcesses());
    EXPECT_EQ(section.shown(), std::string("Version: 2\n"
                                           "Sub Frames: 1022\n"
                                           "Carrier Info: Dual Carrier\n") +
                                   kPrimary + kFirstSecondary +
                                   "  -\n"
                                   "    Process ID: 255\n"
                                   "    No Rx Bits: 1\n"
                                   "    New Tx: 2\n"
                                   "    Block Errors: 3\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>HSDPA Info"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x4221));
}

TEST(HSDPAInformation, ReadsTheSecondaryProcessesAt18WithoutPrimaryOnes)
{
    SectionFixture<HSDPAInformation> section(makeDictionary());
    section.receive(0x4221, PacketBuilder(27).u8(17, 1).u8(18, 6).u32(19, 7).u16(23, 8).u16(25, 9));
    EXPECT_EQ(section.row("Secondary HARQ Process"),
              "-\n  Process ID: 6\n  No Rx Bits: 7\n  New Tx: 8\n  Block Errors: 9\n");
    EXPECT_EQ(section.row("Primary HARQ Process"), "(none)");
}

TEST(HSDPAInformation, ReadsTheSecondaryProcessesAt342BehindTwoPrimaryOnes)
{
    SectionFixture<HSDPAInformation> section(makeDictionary());
    section.receive(0x4221, PacketBuilder(351).u8(16, 2).u8(17, 1).u8(27, 3).u8(342, 6));
    EXPECT_EQ(section.row("Primary HARQ Process"),
              "-\n  Process ID: 0\n  No Rx Bits: 0\n  New Tx: 0\n  Block Errors: 0\n"
              "-\n  Process ID: 3\n  No Rx Bits: 0\n  New Tx: 0\n  Block Errors: 0\n");
    EXPECT_EQ(section.row("Secondary HARQ Process"),
              "-\n  Process ID: 6\n  No Rx Bits: 0\n  New Tx: 0\n  Block Errors: 0\n");
}

TEST(HSDPAInformation, LeavesTheListsWhenTheCountsAreNone)
{
    SectionFixture<HSDPAInformation> section(makeDictionary());
    section.receive(0x4221, harqProcesses().u8(17, 1));
    section.receive(0x4221, PacketBuilder(18).u8(13, 9));
    EXPECT_EQ(section.shown(), std::string("Version: 9\n"
                                           "Sub Frames: 0\n"
                                           "Carrier Info: Single Carrier\n") +
                                   kPrimary + kFirstSecondary);
}

TEST(HSDPAInformation, ReplacesOneListAndLeavesTheOther)
{
    SectionFixture<HSDPAInformation> section(makeDictionary());
    section.receive(0x4221, harqProcesses());
    section.receive(0x4221, PacketBuilder(27).u8(16, 1).u8(18, 77));
    EXPECT_EQ(section.row("Primary HARQ Process"),
              "-\n  Process ID: 77\n  No Rx Bits: 0\n  New Tx: 0\n  Block Errors: 0\n");
    EXPECT_EQ(section.entry.dictionary()->at("Secondary HARQ Process").array()->elements.size(), 2U);
}

TEST(HSDPAInformation, DropsProcessesThatAreNotWhollyInThePacket)
{
    SectionFixture<HSDPAInformation> section(makeDictionary());
    section.receive(0x4221, harqProcesses().length(197));
    EXPECT_EQ(section.shown(), std::string("Version: 2\n"
                                           "Sub Frames: 1022\n"
                                           "Carrier Info: Dual Carrier\n") +
                                   kPrimary + kFirstSecondary);
    // None of them inside is as a count of none: the lists stay.
    section.receive(0x4221, harqProcesses().u8(13, 3).length(26));
    EXPECT_EQ(section.shown(), std::string("Version: 3\n"
                                           "Sub Frames: 1022\n"
                                           "Carrier Info: Dual Carrier\n") +
                                   kPrimary + kFirstSecondary);
}

TEST(HSDPAInformation, TakesTheSubFramesHighBitsAndTheCarriersFromOneByte)
{
    SectionFixture<HSDPAInformation> section(makeDictionary());
    section.receive(0x4221, PacketBuilder(18).u8(13, 255).u8(15, 0x0B));
    EXPECT_EQ(section.shown(), "Version: 255\nSub Frames: 768\nCarrier Info: Dual Carrier\n");
    section.receive(0x4221, PacketBuilder(18).u8(14, 0xFF).u8(15, 0xF0));
    EXPECT_EQ(section.shown(), "Version: 0\nSub Frames: 255\nCarrier Info: Single Carrier\n");
}

INSTANTIATE_TEST_SUITE_P(HSDPACarriers, ShownTextOf,
                         shownTexts("HSDPA Info", 0x4221, 18, 15, "Carrier Info",
                                    {{0x00, "Single Carrier"},
                                     {0x04, "MIMO"},
                                     {0x08, "Dual Carrier"},
                                     {0x0C, "Reserved"},
                                     {0xFF, "Reserved"}}));
INSTANTIATE_TEST_SUITE_P(HSDPASubFrames, ShownTextOf,
                         shownTexts("HSDPA Info", 0x4221, 18, 15, "Sub Frames",
                                    {{0x00, "0"}, {0x01, "256"}, {0x03, "768"}, {0xFC, "0"}}));

} // namespace
} // namespace pelorus::test
