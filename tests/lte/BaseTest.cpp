#include "LogGenerator/Osprey/Base.h"

#include "LogGenerator/Osprey/ArrayLock.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>
#include <stdexcept>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

class NamelessSection : public Base {};

class SampleSection : public Base {
public:
    SampleSection(std::string sectionName, std::vector<LogCode> logCodes)
        : name(std::move(sectionName)), codes(std::move(logCodes))
    {}
    std::string getSectionName() const override { return name; }
    std::vector<LogCode> getLogCodeArray() const override { return codes; }
    void updateWithData(const LogPacket&, LogCode) override
    {
        keyedEntry()->set("Row", "written");
        listEntry()->elements.emplace_back("written");
    }

    using Base::keyedEntry;
    using Base::listEntry;

private:
    std::string name;
    std::vector<LogCode> codes;
};

TEST(Base, DefinesNoneOfTheOperationsOfASection)
{
    NamelessSection section;
    EXPECT_THROW(section.getSectionName(), std::logic_error);
    EXPECT_THROW(section.getLogCodeArray(), std::logic_error);
    EXPECT_THROW(section.updateWithData(LogPacket(), 0xB179), std::logic_error);
}

TEST(Base, RegistersUnderItsNameAndSubscribesToItsCodesInOrder)
{
    ClassDictionary classDict;
    CodeDictionary codeDict;
    RecordingLog log;
    SampleSection section("Sample", {45250, 0xFF0001});
    section.initWithDict(classDict, codeDict);
    EXPECT_EQ(classDict.at("Sample"), &section);
    EXPECT_THAT(codeDict.allKeys(), ElementsAre("45250", "16711681"));
    EXPECT_THAT(*codeDict.find(0xB0C2), ElementsAre(&section));
    EXPECT_THAT(*codeDict.find(0xFF0001), ElementsAre(&section));
    EXPECT_THAT(codeDict["16711681"], ElementsAre(&section));
    EXPECT_EQ(codeDict.find(0xFF0002), nullptr);
    EXPECT_THAT(log.take(), ElementsAre("<4>Array Count: 2"));
}

TEST(Base, SubscribesToNothingWithAnEmptyList)
{
    ClassDictionary classDict;
    CodeDictionary codeDict;
    RecordingLog log;
    SampleSection section("Sample", {});
    section.initWithDict(classDict, codeDict);
    EXPECT_EQ(classDict.at("Sample"), &section);
    EXPECT_TRUE(codeDict.allKeys().empty());
    EXPECT_THAT(log.take(), ElementsAre("<4>Array Count: 0"));
}

TEST(Base, SubscribesTwiceToACodeThatItListsTwice)
{
    ClassDictionary classDict;
    CodeDictionary codeDict;
    SampleSection section("Sample", {7, 7});
    section.initWithDict(classDict, codeDict);
    EXPECT_THAT(*codeDict.find(7), ElementsAre(&section, &section));
    EXPECT_THAT(codeDict.allKeys(), ElementsAre("7"));
}

TEST(Base, SubscribersOfOneCodeStandInTheOrderOfTheirCreation)
{
    ClassDictionary classDict;
    CodeDictionary codeDict;
    SampleSection first("Zulu", {7});
    SampleSection second("Alpha", {7});
    first.initWithDict(classDict, codeDict);
    second.initWithDict(classDict, codeDict);
    EXPECT_THAT(*codeDict.find(7), ElementsAre(&first, &second));
}

TEST(Base, TheLaterOfTwoSectionsOfOneNameHasTheNameAndBothHaveTheCode)
{
    ClassDictionary classDict;
    CodeDictionary codeDict;
    SampleSection first("Sample", {7});
    SampleSection second("Sample", {7});
    first.initWithDict(classDict, codeDict);
    second.initWithDict(classDict, codeDict);
    EXPECT_EQ(classDict.size(), 1U);
    EXPECT_EQ(classDict.at("Sample"), &second);
    EXPECT_THAT(*codeDict.find(7), ElementsAre(&first, &second));
}

TEST(Base, LogsItsNameWhenItIsBound)
{
    RecordingLog log;
    SampleSection section("100% Sample", {});
    section.updateSectionRef(makeDictionary());
    EXPECT_THAT(log.take(), ElementsAre("<4>100% Sample"));
}

TEST(Base, WritesIntoTheEntryThatTheDisplayHolds)
{
    SampleSection section("Sample", {});
    const Value rows = makeDictionary();
    section.updateSectionRef(rows);
    section.updateWithData(LogPacket(), 0);
    EXPECT_EQ(textOf(rows), "Row: written\n");

    const Value list = makeArray();
    section.updateSectionRef(list);
    section.updateWithData(LogPacket(), 0);
    EXPECT_EQ(textOf(list), "- written\n");
    EXPECT_EQ(rows.dictionary()->size(), 1U);
}

TEST(Base, WritesNowhereWithoutAnEntry)
{
    SampleSection section("Sample", {});
    EXPECT_NO_THROW(section.updateWithData(LogPacket(), 0));
    EXPECT_TRUE(section.keyedEntry()->empty());
    EXPECT_TRUE(section.listEntry()->elements.empty());

    section.updateSectionRef("a text");
    EXPECT_NO_THROW(section.updateWithData(LogPacket(), 0));
    EXPECT_TRUE(section.keyedEntry()->empty());
}

TEST(Base, DoesNotKeepItsEntryAlive)
{
    SampleSection section("Sample", {});
    std::weak_ptr<Dictionary> watched;
    {
        const auto rows = makeDictionary();
        watched = rows;
        section.updateSectionRef(rows);
    }
    EXPECT_TRUE(watched.expired());
    EXPECT_NO_THROW(section.updateWithData(LogPacket(), 0));
}

TEST(Base, EmptiesAndReplacesAListInPlaceAndLeavesTheLockFree)
{
    const auto list = makeArray({"a", "b"});
    std::vector<Value> elements{"c", "d", "e"};
    Base::replaceArray(*list, elements);
    EXPECT_EQ(textOf(list), "- c\n- d\n- e\n");
    Base::clearElementsInArray(*list);
    EXPECT_EQ(textOf(list), "");
    elements.clear();
    Base::replaceArray(*list, elements);
    EXPECT_EQ(textOf(list), "");
    EXPECT_TRUE(ArrayLock::isFreeForOthers());
}

struct Boundary {
    std::uint32_t value;
    int decibels;
};

class EnergyRatio : public testing::TestWithParam<Boundary> {};

TEST_P(EnergyRatio, GivesWholeDecibels)
{
    EXPECT_EQ(Base::lookUpECNO(GetParam().value), GetParam().decibels);
}

// Each threshold from both sides. Above full scale and below the lowest band the result is 0, and the two
// lowest bands give the same: meant.
INSTANTIATE_TEST_SUITE_P(
    Boundaries, EnergyRatio,
    testing::Values(Boundary{4294967295, 0}, Boundary{524289, 0}, Boundary{524288, 0}, Boundary{524287, -1},
                    Boundary{417648, -1}, Boundary{417647, -2}, Boundary{331809, -2}, Boundary{331808, -3},
                    Boundary{263625, -3}, Boundary{263624, -4}, Boundary{209464, -4}, Boundary{209463, -5},
                    Boundary{166442, -5}, Boundary{166441, -6}, Boundary{132269, -6}, Boundary{132268, -7},
                    Boundary{105124, -7}, Boundary{105123, -8}, Boundary{83563, -8}, Boundary{83562, -9},
                    Boundary{66436, -9}, Boundary{66435, -10}, Boundary{52831, -10}, Boundary{52830, -11},
                    Boundary{42024, -11}, Boundary{42023, -12}, Boundary{33441, -12}, Boundary{33440, -13}));

INSTANTIATE_TEST_SUITE_P(
    LowerBoundaries, EnergyRatio,
    testing::Values(Boundary{26622, -13}, Boundary{26621, -14}, Boundary{21206, -14}, Boundary{21205, -15},
                    Boundary{16904, -15}, Boundary{16903, -16}, Boundary{13487, -16}, Boundary{13486, -17},
                    Boundary{10772, -17}, Boundary{10771, -18}, Boundary{8616, -18}, Boundary{8615, -19},
                    Boundary{6903, -19}, Boundary{6902, -20}, Boundary{5543, -20}, Boundary{5542, -21},
                    Boundary{4462, -21}, Boundary{4461, -22}, Boundary{3604, -22}, Boundary{3603, -23},
                    Boundary{2922, -23}, Boundary{2921, -24}, Boundary{2241, -24}, Boundary{2240, -25},
                    Boundary{1950, -25}, Boundary{1949, -26}, Boundary{1608, -26}, Boundary{1607, -27},
                    Boundary{1337, -27}, Boundary{1336, -28}, Boundary{1121, -28}, Boundary{1120, -29},
                    Boundary{950, -29}, Boundary{949, -30}, Boundary{814, -30}, Boundary{813, -31},
                    Boundary{757, -31}, Boundary{756, -31}, Boundary{706, -31}, Boundary{705, 0},
                    Boundary{1, 0}, Boundary{0, 0}));

} // namespace
} // namespace pelorus::test
