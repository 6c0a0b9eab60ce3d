#include "LogGenerator/Osprey/LTE/LTEClassIndex.h"

#include "platform/Console.h"
#include "tests/support/HostilePackets.h"
#include "tests/support/RecordingLog.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::UnorderedElementsAre;

std::vector<std::string> subscribers(const ClassIndex& index, LogCode code)
{
    std::vector<std::string> names;
    if (const auto* sections = index.getSubscribers(code))
        for (const Base* section : *sections)
            names.push_back(section->getSectionName());
    return names;
}

constexpr const char* kKeyedSections[] = {
    "Serving Cell Info",         "Connected mode LTE Intra-frequency Measurement",
    "Serving Cell Measurements", "Neighbor Measurements",
    "Reselection Candidates",    "SIM Info"};
constexpr const char* kListSections[] = {"Measured Neighbor Cells", "Detected Cells", "Neighbor Cells List",
                                         "Reselection Candidates List", "PDP Context Info"};

TEST(LTEClassIndex, FindsEachSectionByItsName)
{
    const LTEClassIndex index;
    for (const char* name : kKeyedSections)
        EXPECT_EQ(index.getClass(name)->getSectionName(), name);
    for (const char* name : kListSections)
        EXPECT_EQ(index.getClass(name)->getSectionName(), name);
    EXPECT_NE(dynamic_cast<LTEServingCellInfo*>(index.getClass("Serving Cell Info")), nullptr);
    EXPECT_EQ(index.getClass("serving cell info"), nullptr);
    EXPECT_EQ(index.getClass(""), nullptr);
}

TEST(LTEClassIndex, CallsTheSubscribersOfACodeInTheOrderOfCreation)
{
    const LTEClassIndex index;
    EXPECT_THAT(subscribers(index, 0xB0C1), ElementsAre("Serving Cell Info"));
    EXPECT_THAT(subscribers(index, 0xB0C2), ElementsAre("Serving Cell Info"));
    EXPECT_THAT(subscribers(index, 0xB179), ElementsAre("Connected mode LTE Intra-frequency Measurement",
                                                        "Measured Neighbor Cells", "Detected Cells"));
    EXPECT_THAT(subscribers(index, 0xB17F), ElementsAre("Serving Cell Measurements"));
    EXPECT_THAT(subscribers(index, 0xB180), ElementsAre("Neighbor Measurements", "Neighbor Cells List"));
    EXPECT_THAT(subscribers(index, 0xB186),
                ElementsAre("Reselection Candidates", "Reselection Candidates List"));
    EXPECT_THAT(subscribers(index, 0xFF0000), ElementsAre("SIM Info"));
    EXPECT_THAT(subscribers(index, 0xFF0001), ElementsAre("Serving Cell Info"));
    EXPECT_THAT(subscribers(index, 0xFF0002), ElementsAre("PDP Context Info"));
}

TEST(LTEClassIndex, HasNoSubscribersOfOtherCodes)
{
    const LTEClassIndex index;
    EXPECT_EQ(index.getSubscribers(0xB181), nullptr);
    EXPECT_EQ(index.getSubscribers(0), nullptr);
    EXPECT_EQ(index.getSubscribers(1), nullptr);
    EXPECT_EQ(index.getSubscribers(0xFF0003), nullptr);
}

TEST(LTEClassIndex, NamesEachCodeOnce)
{
    EXPECT_THAT(LTEClassIndex().getAllLogCodes(),
                UnorderedElementsAre("45249", "45250", "45433", "45439", "45440", "45446", "16711680",
                                     "16711681", "16711682"));
}

TEST(LTEClassIndex, LogsTheNumberOfCodesOfEachSectionAsItIsCreated)
{
    RecordingLog log;
    const LTEClassIndex index;
    EXPECT_THAT(log.take(), ElementsAre("<4>Array Count: 3", "<4>Array Count: 1", "<4>Array Count: 1",
                                        "<4>Array Count: 1", "<4>Array Count: 1", "<4>Array Count: 1",
                                        "<4>Array Count: 1", "<4>Array Count: 1", "<4>Array Count: 1",
                                        "<4>Array Count: 1", "<4>Array Count: 1"));
}

TEST(LTEClassIndex, LogsItsStatus)
{
    const LTEClassIndex index;
    RecordingLog log;
    index.status();
    EXPECT_THAT(log.take(), ElementsAre("<4>Dictionary = 1", "<4>String = 0"));
}

TEST(LTEClassIndex, TellsTheConsoleThatItGoes)
{
    std::vector<std::string> lines;
    setConsole([&lines](std::string_view line) { lines.emplace_back(line); });
    {
        const LTEClassIndex index;
        EXPECT_TRUE(lines.empty());
    }
    setConsole(nullptr);
    EXPECT_THAT(lines, ElementsAre("Deallocing ClassIndex"));
}

class HostileLTEPackets : public testing::Test {
protected:
    HostileLTEPackets()
    {
        for (const char* name : kKeyedSections) {
            entries.emplace_back(makeDictionary());
            index.getClass(name)->updateSectionRef(entries.back());
        }
        for (const char* name : kListSections) {
            entries.emplace_back(makeArray());
            index.getClass(name)->updateSectionRef(entries.back());
        }
    }

    /// Hands the packet to every section, also to those that never subscribed to the code.
    void receive(const LogPacket& packet, LogCode code)
    {
        for (const char* name : kKeyedSections) {
            if (code == 0xFF0000 && std::string_view(name) == "SIM Info")
                continue;
            EXPECT_NO_THROW(index.getClass(name)->updateWithData(packet, code)) << name;
        }
        for (const char* name : kListSections)
            EXPECT_NO_THROW(index.getClass(name)->updateWithData(packet, code)) << name;
        for (const Value& entry : entries)
            EXPECT_LE(entry.array() ? entry.array()->elements.size() : entry.dictionary()->size(), 255U);
    }

    static constexpr LogCode kCodes[] = {0xB0C1, 0xB0C2,   0xB179,   0xB17F,   0xB180,
                                         0xB186, 0xFF0000, 0xFF0001, 0xFF0002, 0x1234};

    LTEClassIndex index;
    std::vector<Value> entries;
};

TEST_F(HostileLTEPackets, OfRandomBytesRaiseNothing)
{
    forRandomPackets(2000, 700, [this](const LogPacket& packet) {
        for (const LogCode code : kCodes)
            receive(packet, code);
    });
}

TEST_F(HostileLTEPackets, CutShortAnywhereRaiseNothing)
{
    const std::vector<std::byte> ones(21 + 32 * 20, std::byte{0xFF});
    forEachPrefix(ones, [this](const LogPacket& packet) {
        for (const LogCode code : kCodes)
            receive(packet, code);
    });
}

TEST_F(HostileLTEPackets, WithUnreadableSimFilesEndInTheirOwnException)
{
    std::size_t raised = 0;
    forRandomPackets(200, 200, [&](const LogPacket& packet) {
        try {
            index.getClass("SIM Info")->updateWithData(packet, 0xFF0000);
        } catch (const LogCode_0xFF0000::UnknownDataException&) {
            ++raised;
        }
    });
    EXPECT_EQ(raised, 200U);
}

TEST(LTEClassIndexUnbound, DecodesIntoNothingWithoutADisplay)
{
    const LTEClassIndex index;
    const std::vector<std::byte> ones(700, std::byte{0xFF});
    for (const LogCode code : {0xB0C1, 0xB0C2, 0xB179, 0xB17F, 0xB180, 0xB186, 0xFF0001, 0xFF0002})
        for (Base* section : *index.getSubscribers(code))
            EXPECT_NO_THROW(section->updateWithData(LogPacket(ones), code)) << section->getSectionName();
}

} // namespace
} // namespace pelorus::test
