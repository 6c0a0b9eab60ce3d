#include "LogGenerator/Osprey/GSM/ActiveSet.h"
#include "LogGenerator/Osprey/GSM/EmptyCellSets.h"
#include "tests/gsm/Packets.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

TEST(ActiveSet, ShowsTheCellsWhoseSetIsNone)
{
    SectionFixture<ActiveSet> section(makeArray());
    section.receive(0x417A, followedCells());
    EXPECT_EQ(section.shown(), "-\n"
                               "  Scrambling Code: 301\n"
                               "  RSCP: -122 dB\n"
                               "  Energy Per Chip: -8 dB\n"
                               "-\n"
                               "  Scrambling Code: 8191\n"
                               "  RSCP: -139 dB\n"
                               "  Energy Per Chip: -25 dB\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>ActiveSet"));
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0x417A));
}

// One cell in the active set; its measurement stands at 31.
PacketBuilder oneCell(int power, std::uint32_t first, std::uint32_t second, std::uint32_t third)
{
    return PacketBuilder(75).s16(13, power).u8(15, 1).u32(63, first).u32(67, second).u32(71, third);
}

TEST(ActiveSet, TakesTheFirstEnergyThatIsNotZero)
{
    SectionFixture<ActiveSet> section(makeArray());
    section.receive(0x417A, oneCell(0, 0, 0, 500000));
    EXPECT_EQ(section.shown(), "-\n  Scrambling Code: 0\n  RSCP: -56 dB\n  Energy Per Chip: -1 dB\n");
    section.receive(0x417A, oneCell(0, 0, 400000, 500000));
    EXPECT_EQ(section.shown(), "-\n  Scrambling Code: 0\n  RSCP: -57 dB\n  Energy Per Chip: -2 dB\n");
    section.receive(0x417A, oneCell(0, 900, 400000, 500000));
    EXPECT_EQ(section.shown(), "-\n  Scrambling Code: 0\n  RSCP: -85 dB\n  Energy Per Chip: -30 dB\n");
    section.receive(0x417A, oneCell(0, 0, 0, 0));
    EXPECT_EQ(section.shown(), "-\n  Scrambling Code: 0\n  RSCP: -55 dB\n  Energy Per Chip: 0 dB\n");
    section.receive(0x417A, oneCell(0, 0xFFFFFFFF, 0, 0)); // above full scale, and unsigned
    EXPECT_EQ(section.shown(), "-\n  Scrambling Code: 0\n  RSCP: -55 dB\n  Energy Per Chip: 0 dB\n");
}

TEST(ActiveSet, RoundsThePowerTowardsZero)
{
    SectionFixture<ActiveSet> section(makeArray());
    const auto rscp = [&](int power) {
        section.receive(0x417A, oneCell(power, 0, 0, 0));
        return *section.entry.array()->elements.at(0).dictionary()->at("RSCP").string();
    };
    EXPECT_EQ(rscp(-600), "-114 dB"); // -8.8 and -106
    EXPECT_EQ(rscp(-513), "-106 dB"); // -0.1
    EXPECT_EQ(rscp(-503), "-106 dB"); // 0.9
    EXPECT_EQ(rscp(-502), "-105 dB");
    EXPECT_EQ(rscp(32767), "3221 dB");
    EXPECT_EQ(rscp(-32768), "-3331 dB");
}

TEST(ActiveSet, SkipsEveryOtherSet)
{
    SectionFixture<ActiveSet> section(makeArray());
    for (unsigned set = 1; set < 8; ++set) {
        section.receive(0x417A, oneCell(0, 1, 1, 1).u8(24, set << 5));
        EXPECT_EQ(section.shown(), "") << set;
    }
}

TEST(ActiveSet, ShowsOneOfTwoCellsAndTheOtherSetsNone)
{
    const PacketBuilder packet = PacketBuilder(134).u8(15, 2).u8(16 + 7, 5).u8(31 + 8, 0x20);
    SectionFixture<ActiveSet> active(makeArray());
    SectionFixture<DetectedSet> detected(makeArray({"old"}));
    SectionFixture<MonitoredSet> monitored(makeArray({"old"}));
    SectionFixture<VirtualActiveSet> virtualActive(makeArray({"old"}));
    active.receive(0x417A, packet);
    detected.receive(0x417A, packet);
    monitored.receive(0x417A, packet);
    virtualActive.receive(0x417A, packet);
    EXPECT_EQ(active.shown(), "-\n  Scrambling Code: 5\n  RSCP: -55 dB\n  Energy Per Chip: 0 dB\n");
    EXPECT_EQ(detected.shown() + monitored.shown() + virtualActive.shown(), "");
}

TEST(ActiveSet, IsEmptiedByACountOfNone)
{
    SectionFixture<ActiveSet> section(makeArray());
    section.receive(0x417A, followedCells());
    section.receive(0x417A, followedCells().u8(15, 0));
    EXPECT_EQ(section.shown(), "");
}

TEST(ActiveSet, DropsACellWhoseMeasurementIsNotWhollyInThePacket)
{
    SectionFixture<ActiveSet> section(makeArray());
    section.receive(0x417A, followedCells().length(192));
    EXPECT_EQ(section.shown(), "-\n  Scrambling Code: 301\n  RSCP: -122 dB\n  Energy Per Chip: -8 dB\n");
    section.receive(0x417A, followedCells().length(104)); // cells, and one byte less than a measurement
    EXPECT_EQ(section.shown(), "");
    section.receive(0x417A, followedCells().u8(15, 255)); // the measurements would begin at 3841
    EXPECT_EQ(section.shown(), "");
}

TEST(EmptyCellSets, SubscribeToTheFollowedCells)
{
    EXPECT_THAT(DetectedSet().getLogCodeArray(), ElementsAre(0x417A));
    EXPECT_THAT(MonitoredSet().getLogCodeArray(), ElementsAre(0x417A));
    EXPECT_THAT(VirtualActiveSet().getLogCodeArray(), ElementsAre(0x417A));
}

} // namespace
} // namespace pelorus::test
