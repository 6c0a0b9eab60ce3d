#include "LogGenerator/Osprey/GSM/HSDPAInformation.h"
#include "LogGenerator/Osprey/TableSection.h"
#include "tests/support/SectionFixture.h"

#include <gtest/gtest.h>

namespace pelorus::test {
namespace {

/// A section that is bound to an empty entry, while nobody reads the system log.
template <class Section> class Waiting : public SectionFixture<Section> {
public:
    Waiting() : SectionFixture<Section>(makeDictionary()) { setSystemLogSink(nullptr); }
    ~Waiting() { setSystemLogSink(&this->log); }
    Waiting(const Waiting&) = delete;
    Waiting& operator=(const Waiting&) = delete;

    void receive(LogCode code, const PacketBuilder& packet)
    {
        this->section.receive(LogPacket(packet.bytes()), code);
    }
    std::string settled()
    {
        this->section.settle();
        return this->shown();
    }
};

constexpr std::string_view kSwitch[] = {"Off", "On"};
constexpr Row kNumberRows[] = {number("Number", "%d", u8(13))};
constexpr Row kSwitchRows[] = {number("Level", "%d", u8(13)), text("Switch", u8(14), kSwitch, {})};
constexpr Row kBitRows[] = {text("Bit", bits(13, 0, 1), kSwitch, {})};
constexpr Reading kReadings[] = {
    {0x1234, 14, kNumberRows}, {0x1235, 15, kSwitchRows}, {0x1236, 14, kBitRows}};
constexpr SectionDescription kDescription{"Section", "Section", kReadings};

class Section : public TableSection {
public:
    Section() : TableSection(kDescription) {}
};

PacketBuilder packet(int first, int second = 0)
{
    return PacketBuilder(15)
        .u8(13, static_cast<std::uint8_t>(first))
        .u8(14, static_cast<std::uint8_t>(second));
}

TEST(WaitingPackets, AreShownWhenSomebodyLooks)
{
    Waiting<Section> section;
    section.receive(0x1234, packet(1)); // makes the row
    EXPECT_EQ(section.shown(), "Number: 1\n");
    section.receive(0x1234, packet(2));
    section.receive(0x1234, packet(3));
    EXPECT_EQ(section.shown(), "Number: 1\n");
    EXPECT_EQ(section.settled(), "Number: 3\n");
    EXPECT_EQ(section.settled(), "Number: 3\n");
}

TEST(WaitingPackets, TooShortOnesOvertakeNothing)
{
    Waiting<Section> section;
    section.receive(0x1234, packet(1));
    section.receive(0x1234, packet(2));
    section.receive(0x1234, PacketBuilder(13));
    EXPECT_EQ(section.settled(), "Number: 2\n");
}

TEST(WaitingPackets, AreShownBeforeOneThatCannotWait)
{
    Waiting<Section> section;
    section.receive(0x1234, packet(1));
    section.receive(0x1234, packet(2));
    section.receive(0x1235, packet(3, 1));
    EXPECT_EQ(section.shown(), "Number: 2\nLevel: 3\nSwitch: On\n");
    section.receive(0x1234, packet(4));
    section.section.updateWithData(LogPacket(packet(5).bytes()), 0x1234);
    EXPECT_EQ(section.shown(), "Number: 5\nLevel: 3\nSwitch: On\n");
}

TEST(WaitingPackets, RowThatAPacketMayLeaveAloneWaitsForNobody)
{
    Waiting<Section> section;
    section.receive(0x1235, packet(1, 0));
    section.receive(0x1235, packet(2, 1));
    section.receive(0x1235, packet(3, 2)); // no text for 2
    EXPECT_EQ(section.settled(), "Level: 3\nSwitch: On\n");
}

TEST(WaitingPackets, TextsOfAllValuesWait)
{
    Waiting<Section> section;
    section.receive(0x1236, packet(0));
    section.receive(0x1236, packet(1));
    EXPECT_EQ(section.shown(), "Bit: Off\n");
    EXPECT_EQ(section.settled(), "Bit: On\n");
}

TEST(WaitingPackets, GoToTheEntryThatTheyCameFor)
{
    Waiting<Section> section;
    section.receive(0x1234, packet(1));
    section.receive(0x1234, packet(2));
    const Value another = makeDictionary();
    section.section.updateSectionRef(another);
    EXPECT_EQ(section.shown(), "Number: 2\n");
    section.receive(0x1234, packet(3));
    EXPECT_EQ(section.settled(), "Number: 2\n");
    EXPECT_EQ(textOf(another), "Number: 3\n");
}

TEST(WaitingPackets, OfHSDPADoNotHideListsThatALaterOneHasNot)
{
    const auto processes = [](int primary, int secondary) { // behind the header: counts, lists
        PacketBuilder packet(200);
        if (primary)
            packet.u8(16, 1).u8(18, static_cast<std::uint8_t>(primary));
        if (secondary)
            packet.u8(17, 1).u8(primary ? 180 : 18, static_cast<std::uint8_t>(secondary));
        return packet;
    };
    const auto identities = [](Waiting<HSDPAInformation>& section) {
        section.section.settle();
        const auto identity = [&](const char* list) {
            const Value* rows = section.entry.dictionary()->find(list);
            return *rows->array()->elements[0].dictionary()->find("Process ID")->string();
        };
        return identity("Primary HARQ Process") + " " + identity("Secondary HARQ Process");
    };
    Waiting<HSDPAInformation> section;
    section.receive(0x4221, processes(1, 1));
    section.receive(0x4221, processes(2, 2));
    section.receive(0x4221, processes(0, 0));
    EXPECT_EQ(identities(section), "2 2");
    section.receive(0x4221, processes(0, 0));
    section.receive(0x4221, processes(3, 0));
    section.receive(0x4221, processes(0, 9));
    EXPECT_EQ(identities(section), "3 9");
    section.receive(0x4221, processes(4, 4));
    section.receive(0x4221, processes(5, 0));
    EXPECT_EQ(identities(section), "5 4");
    section.receive(0x4221, processes(0, 6));
    section.receive(0x4221, processes(0, 7));
    section.receive(0x4221, processes(8, 8));
    EXPECT_EQ(identities(section), "8 8");
}

TEST(TextTable, ListsEveryValueOfAField)
{
    constexpr std::string_view gap[] = {"Zero", "", "Two", "Three"};
    constexpr ValueText scattered[] = {{1, "One"}, {0, "Zero"}};
    EXPECT_TRUE(TextTable(kSwitch).listsEvery(bits(0, 0, 1)));
    EXPECT_TRUE(TextTable(scattered).listsEvery(bits(0, 3, 1)));
    EXPECT_FALSE(TextTable(kSwitch).listsEvery(bits(0, 0, 2)));
    EXPECT_FALSE(TextTable(gap).listsEvery(bits(0, 0, 2)));
    EXPECT_FALSE(TextTable(kSwitch).listsEvery(s8(0)));
    EXPECT_FALSE(TextTable(kSwitch).listsEvery(u16(0)));
}

} // namespace
} // namespace pelorus::test
