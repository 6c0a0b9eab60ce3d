#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "tests/generator/ProbeFixture.h"
#include "tests/support/SectionFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;

/// A restart makes a new generator; the state, and what is in it, lives on.
class TakingOver : public ProbeFixture {
protected:
    TakingOver()
    {
        generator.updateState(state, packet(1, 0x1234).bytes());
        generator.generateLogUsingState(state);
        log.take();
    }
    std::string shown() const { return textOf(state.at("Display")); }
};

TEST_F(TakingOver, OwnKindGoesOnInTheEntriesThatAreThere)
{
    state.find("Display")->dictionary()->at("First").dictionary()->set("Kept", "yes");
    const auto display = state.at("Display").sharedDictionary();
    ProbeGenerator next(platform, std::make_shared<ProbeIndex>());
    log.take();
    next.updateState(state, packet(0xFF, 0x0001).bytes());
    EXPECT_THAT(log.take(), ElementsAre("<4>First", "<4>Second"));
    EXPECT_EQ(state.at("Display").sharedDictionary(), display);
    EXPECT_EQ(shown(), "First:\n  Code: 0xff0001\n  Kept: yes\nSecond:\n  Code: 0x1234\n");
}

TEST_F(TakingOver, OwnKindShowsItAtOnce)
{
    ProbeGenerator next(platform, std::make_shared<ProbeIndex>());
    EXPECT_EQ(next.generateLogUsingState(state).dictionary(), state.at("Display").dictionary());
}

TEST_F(TakingOver, OwnKindBindsSectionsAtAnyDepth)
{
    state.clear();
    platform.addResource("Probe",
                         propertyListText("<dict><key>Group</key><array><dict><key>First</key><dict/>"
                                          "</dict></array></dict>"));
    ProbeGenerator one(platform, std::make_shared<ProbeIndex>());
    one.updateState(state, packet(1, 0x1234).bytes());
    ProbeGenerator two(platform, std::make_shared<ProbeIndex>());
    two.updateState(state, packet(1, 0x0001).bytes());
    EXPECT_EQ(shown(), "Group:\n  -\n    First:\n      Code: 0x1\n");
}

TEST_F(TakingOver, RawMessagesOfTheOneBeforeAreLost)
{
    generator.updateState(state, packet(1, 0x0001).bytes());
    ProbeGenerator next(platform, std::make_shared<ProbeIndex>());
    next.generateLogUsingState(state);
    EXPECT_EQ(state.at("DisplayState"), Value(makeData({})));
}

TEST_F(TakingOver, AnotherTechnologysDisplayIsDropped)
{
    state.set("Lookup", makeDictionary());
    GSMLogGenerator other(platform);
    other.generateLogUsingState(state);
    for (const char* key : {"Template", "Display", "Lookup", "ExtraInfo"})
        EXPECT_FALSE(state.find(key)) << key;
    EXPECT_EQ(state.at("History").array()->elements.size(), 2U);
}

TEST_F(TakingOver, DisplayOfNobodyIsDropped)
{
    state.find("Display")->dictionary()->at("First").dictionary()->set("Kept", "yes");
    state.set("DisplayMaker", 7);
    ProbeGenerator next(platform, std::make_shared<ProbeIndex>());
    next.updateState(state, packet(1, 0x1234).bytes());
    EXPECT_EQ(shown(), "First:\n  Code: 0x1234\nSecond:\n  Code: 0x1234\n");
}

TEST_F(TakingOver, DisplayIsBuiltAnewAfterAnotherTechnology)
{
    GSMLogGenerator(platform).generateLogUsingState(state);
    state.set("Display", makeDictionary({{"IFX", "x"}}));
    ProbeGenerator next(platform, std::make_shared<ProbeIndex>());
    EXPECT_FALSE(next.generateLogUsingState(state));
    EXPECT_EQ(shown(), "First:\n  Code: -\nSecond:\n");
    EXPECT_EQ(state.at("History").array()->elements.size(), 3U);
}

} // namespace
} // namespace pelorus::test
