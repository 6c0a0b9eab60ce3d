#include "LogGenerator/Osprey/UTRAN/UTRANClassIndex.h"

#include "tests/support/HostilePackets.h"
#include "tests/support/PacketBuilder.h"
#include "tests/support/RecordingLog.h"
#include "tests/utran/Sections.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::UnorderedElementsAre;

constexpr LogCode kCodes[] = {0xD0E0, 0xD0E2, 0xD00A, 0xD00E, 0xD00C, 0x1234, 0xFF0000, 0xFF0001, 0xFF0002};

std::vector<std::string> subscribers(const ClassIndex& index, LogCode code)
{
    std::vector<std::string> names;
    if (const auto* sections = index.getSubscribers(code))
        for (const Base* section : *sections)
            names.push_back(section->getSectionName());
    return names;
}

TEST(UTRANClassIndex, FindsEachSectionByItsName)
{
    const UTRANClassIndex index;
    for (const char* name : kKeyedSections)
        EXPECT_EQ(index.getClass(name)->getSectionName(), name);
    for (const char* name : kListSections)
        EXPECT_EQ(index.getClass(name)->getSectionName(), name);
    EXPECT_EQ(index.getClass("Neighbor Cells List"), nullptr);
}

TEST(UTRANClassIndex, CallsTheSubscribersOfACodeInTheOrderOfCreation)
{
    const UTRANClassIndex index;
    EXPECT_THAT(subscribers(index, 0xD0E0), ElementsAre("RRC Info"));
    EXPECT_THAT(subscribers(index, 0xD0E2), ElementsAre("Serving Cell Info"));
    EXPECT_THAT(subscribers(index, 0xFF0001), ElementsAre("Serving Cell Info"));
    EXPECT_THAT(subscribers(index, 0xD00A), ElementsAre("Neighbor Cell List"));
    EXPECT_THAT(subscribers(index, 0xD00E), ElementsAre("GSM Neighbor Cell List"));
    EXPECT_THAT(subscribers(index, 0xD00C), ElementsAre("TRCH BLER", "CCTRCH SIR"));
    EXPECT_THAT(subscribers(index, 0xFF0002), ElementsAre("PDP Context Info"));
    EXPECT_THAT(subscribers(index, 0xFF0000), ElementsAre("SIM Info"));
    EXPECT_EQ(index.getSubscribers(0xB179), nullptr);
}

TEST(UTRANClassIndex, NamesEachCodeOnce)
{
    EXPECT_THAT(UTRANClassIndex().getAllLogCodes(),
                UnorderedElementsAre("53472", "53474", "53258", "53262", "53260", "16711680", "16711681",
                                     "16711682"));
}

TEST(UTRANClassIndex, CreatesTheSectionsInTheirOrder)
{
    RecordingLog log;
    const UTRANClassIndex index;
    EXPECT_THAT(log.take(), ElementsAre("<4>Array Count: 1", "<4>Array Count: 2", "<4>Array Count: 1",
                                        "<4>Array Count: 1", "<4>Array Count: 1", "<4>Array Count: 1",
                                        "<4>Array Count: 1", "<4>Array Count: 1"));
    // The two that come last subscribe to one code each, whose keys stand in the order of subscription.
    const std::vector<std::string> codes = index.getAllLogCodes();
    ASSERT_EQ(codes.size(), 8U);
    EXPECT_EQ(codes[6], "16711682"); // PDP contexts
    EXPECT_EQ(codes[7], "16711680"); // SIM files
}

TEST(UTRANClassIndex, ShowsBothListsOfOnePacketAndTheRatesFirst)
{
    const UTRANClassIndex index;
    const Value rates = makeArray();
    const Value values = makeArray();
    index.getClass("TRCH BLER")->updateSectionRef(rates);
    index.getClass("CCTRCH SIR")->updateSectionRef(values);
    const PacketBuilder packet = PacketBuilder(289 + 34 + 8).u16(14, 1 << 12 | 1 << 6);
    RecordingLog log;
    for (Base* section : *index.getSubscribers(0xD00C))
        section->updateWithData(LogPacket(packet.bytes()), 0xD00C);
    EXPECT_EQ(rates.array()->elements.size(), 1U);
    EXPECT_EQ(values.array()->elements.size(), 1U);
    EXPECT_THAT(log.take(), ElementsAre("<5>TRCH BLER Measurement", "<4>CCTRCH SIR Measurement"));
}

class HostileUTRANPackets : public testing::Test {
protected:
    HostileUTRANPackets()
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
        for (const char* name : kListSections) {
            try {
                index.getClass(name)->updateWithData(packet, code);
            } catch (const ArrayOutOfBoundsException&) {
                ++raised;
                EXPECT_TRUE(code == 0xD00A || code == 0xD00E || code == 0xD00C) << code;
                EXPECT_TRUE(entryOf(name).array()->elements.empty()) << name;
            }
        }
        for (const Value& entry : entries)
            EXPECT_LE(entry.array() ? entry.array()->elements.size() : entry.dictionary()->size(), 127U);
    }
    const Value& entryOf(std::string_view list) const
    {
        const auto place = std::find(std::begin(kListSections), std::end(kListSections), list);
        return entries[std::size(kKeyedSections) +
                       static_cast<std::size_t>(place - std::begin(kListSections))];
    }

    UTRANClassIndex index;
    std::vector<Value> entries;
    std::size_t raised = 0;
};

TEST_F(HostileUTRANPackets, OfRandomBytesRaiseNothingButForRecordsBeyondTheEnd)
{
    forRandomPackets(1500, 2600, [this](const LogPacket& packet) {
        for (const LogCode code : kCodes)
            receive(packet, code);
    });
    EXPECT_GT(raised, 0U);
}

TEST_F(HostileUTRANPackets, CutShortAnywhereRaiseNothingButForRecordsBeyondTheEnd)
{
    const std::vector<std::byte> ones(2600, std::byte{0xFF});
    forEachPrefix(ones, [this](const LogPacket& packet) {
        for (const LogCode code : kCodes)
            receive(packet, code);
    });
    EXPECT_GT(raised, 0U);
}

} // namespace
} // namespace pelorus::test
