#include "tests/gsm/IndexFixture.h"
#include "tests/gsm/Packets.h"

#include <fstream>
#include <gmock/gmock.h>
#include <iterator>
#include <map>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

std::string templateText()
{
    std::ifstream file(PELORUS_SOURCE_DIR "/resources/OSP_GSM.plist", std::ifstream::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

Value loadTemplate()
{
    const std::string text = templateText();
    return parsePropertyList(std::as_bytes(std::span(text)));
}

/// Every entry of a section, at any depth, by the section's name.
void collectEntries(const Value& node, const OSP_GSMClassIndex& index,
                    std::multimap<std::string, Value>& entries)
{
    if (const Dictionary* dictionary = node.dictionary())
        for (const auto& [key, value] : *dictionary) {
            if (index.getClass(std::string(key.text())))
                entries.emplace(key.text(), value);
            collectEntries(value, index, entries);
        }
}

std::vector<std::string> labels(const Dictionary& rows)
{
    std::vector<std::string> labels;
    for (const auto& row : rows)
        labels.emplace_back(row.key.text());
    return labels;
}

TEST(OSP_GSMTemplate, HasNoDocumentType)
{
    ASSERT_NE(templateText(), "");
    EXPECT_EQ(templateText().find("DOCTYPE"), std::string::npos);
}

TEST(OSP_GSMTemplate, GroupsTheSectionsInAStableOrder)
{
    const Value display = loadTemplate();
    ASSERT_TRUE(display.dictionary());
    EXPECT_THAT(labels(*display.dictionary()),
                ElementsAre("_sorted", "01;GSM", "02;UMTS", "03;Mobility management", "04;Data", "05;SIM"));
}

TEST(OSP_GSMTemplate, HasEverySectionOnceWithItsKindOfEntry)
{
    const OSP_GSMClassIndex index;
    std::multimap<std::string, Value> entries;
    collectEntries(loadTemplate(), index, entries);
    EXPECT_EQ(entries.size(), 26U);
    for (const auto& [name, entry] : entries) {
        EXPECT_EQ(entries.count(name), 1U) << name;
        EXPECT_EQ(entry.array() != nullptr, showsAList(name)) << name;
        EXPECT_EQ(entry.dictionary() != nullptr, !showsAList(name)) << name;
        EXPECT_TRUE(!entry.array() || entry.array()->elements.empty()) << name;
    }
}

TEST(OSP_GSMTemplate, ShowsADashOrAnEmptyListBeforeTheFirstPacket)
{
    const OSP_GSMClassIndex index;
    std::multimap<std::string, Value> entries;
    collectEntries(loadTemplate(), index, entries);
    std::vector<std::string> lists;
    for (const auto& [name, entry] : entries)
        if (entry.dictionary())
            for (const auto& [key, value] : *entry.dictionary()) {
                if (value.array())
                    lists.emplace_back(key.text());
                EXPECT_TRUE(value == Value("-") || value == Value(makeArray())) << name << ", " << key.text();
            }
    EXPECT_THAT(lists, testing::UnorderedElementsAre("ARFCNs", "Primary HARQ Process",
                                                     "Secondary HARQ Process", "Transport Channels"));
}

// As the sections write them into an entry that has none.
TEST(OSP_GSMTemplate, HasTheRowsOfEverySectionInTheOrderOfTheSection)
{
    OSP_GSMClassIndex index;
    std::multimap<std::string, Value> entries;
    collectEntries(loadTemplate(), index, entries);
    for (const auto& [name, pattern] : entries) {
        if (!pattern.dictionary() || name == "SIM Info") // whose full packet the next test spells
            continue;
        const Value entry = makeDictionary();
        Base* section = index.getClass(name);
        section->updateSectionRef(entry);
        for (const LogCode code : section->getLogCodeArray())
            section->updateWithData(LogPacket(fullPacket(code).bytes()), code);
        EXPECT_EQ(labels(*entry.dictionary()), labels(*pattern.dictionary())) << name;
    }
}

TEST(OSP_GSMTemplate, HasTheRowsOfTheSimInOrder)
{
    const OSP_GSMClassIndex index;
    std::multimap<std::string, Value> entries;
    collectEntries(loadTemplate(), index, entries);
    EXPECT_THAT(labels(*entries.find("SIM Info")->second.dictionary()),
                ElementsAre("EF-ICCID", "EF-MSISDN", "EF-3GPP MAIL BOX DIALING NUMBER",
                            "EF-HPPLMN SEARCH PERIOD", "EF-LOCI", "EF-GPRS/PS-LOCI",
                            "EF-ACCESS CONTROL CLASS", "EF-ADMINISTRATIVE DATA", "EF-FPLMN",
                            "EF-ACTING HPLMN", "EF-RAT MODE", "EF-PLMN NETWORK NAME", "EF-OPERATOR PLMN LIST",
                            "EF-OPLMNAcT"));
}

TEST(OSP_GSMTemplate, GainsNoRowFromAnyFullPacket)
{
    OSP_GSMClassIndex index;
    std::multimap<std::string, Value> entries;
    collectEntries(loadTemplate(), index, entries);
    for (const auto& [name, entry] : entries) {
        if (!entry.dictionary())
            continue;
        Base* section = index.getClass(name);
        section->updateSectionRef(entry);
        const std::vector<std::string> before = labels(*entry.dictionary());
        for (const LogCode code : section->getLogCodeArray())
            section->updateWithData(LogPacket(fullPacket(code).bytes()), code);
        EXPECT_THAT(labels(*entry.dictionary()), testing::UnorderedElementsAreArray(before)) << name;
    }
}

} // namespace
} // namespace pelorus::test
