#include "tests/model/ModelFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::SizeIs;

class History : public testing::Test {
protected:
    History() { platform.setNow(std::chrono::sys_days{2012y / 5 / 4} + 9h + 30min); }

    void record() { LogGenerator::updateHistoryInState(platform, state); }
    const std::vector<Value>& entries() const { return state.find("History")->array()->elements; }
    const Dictionary& newest() const { return *entries().back().dictionary(); }
    std::vector<std::string> keysOfNewest() const
    {
        std::vector<std::string> keys;
        for (const auto& entry : newest())
            keys.emplace_back(entry.key.text());
        return keys;
    }

    ScriptedPlatform platform;
    State state;
};

TEST_F(History, EntryHoldsStateDisplayAndDate)
{
    state.set("ExtraInfo", makeDictionary({{"note", "x"}}));
    state.set("Display", makeDictionary({{"Band", "3"}}));
    state.set("DisplayState", makeData({std::byte{1}}));
    record();
    EXPECT_THAT(keysOfNewest(), ElementsAre("DisplayState", "Display", "ExtraInfo", "Date", "Description"));
    EXPECT_EQ(newest().at("DisplayState"), Value(makeData({std::byte{1}})));
    EXPECT_EQ(newest().at("Display"), Value(makeDictionary({{"Band", "3"}})));
    EXPECT_EQ(newest().at("ExtraInfo"), Value(makeDictionary({{"note", "x"}})));
    EXPECT_EQ(newest().at("Date"), Value("2012-05-04 09:30:00 +0000"));
    EXPECT_EQ(newest().at("Description"), Value("Snapshot (2012-05-04 09:30:00 +0000)"));
}

TEST_F(History, KeepsTheNewestFiveInOrder)
{
    state.set("Display", makeDictionary());
    for (const int number : {1, 2, 3, 4, 5, 6, 7}) {
        state.set("DisplayState", number);
        record();
    }
    ASSERT_THAT(entries(), SizeIs(5));
    for (std::size_t index = 0; index < 5; ++index)
        EXPECT_EQ(entries()[index].dictionary()->at("DisplayState"), Value(static_cast<int>(index) + 3));
}

TEST_F(History, LongerHistoryIsCutToFive)
{
    auto history = makeArray();
    for (int number = 0; number < 9; ++number)
        history->elements.emplace_back(number);
    state.set("History", history);
    record();
    ASSERT_THAT(entries(), SizeIs(5));
    EXPECT_EQ(entries()[0], Value(5));
    EXPECT_EQ(entries()[3], Value(8));
}

TEST_F(History, FifthEntryDropsNone)
{
    for (int number = 0; number < 5; ++number)
        record();
    EXPECT_THAT(entries(), SizeIs(5));
}

// An entry ends at the first value that is missing, whatever comes after it: meant.
TEST_F(History, EntryWithoutDisplayStateIsEmpty)
{
    state.set("Display", makeDictionary());
    state.set("ExtraInfo", makeDictionary());
    record();
    EXPECT_TRUE(newest().empty());
}

TEST_F(History, EntryWithoutDisplayHoldsTheDisplayStateOnly)
{
    state.set("DisplayState", makeData({}));
    state.set("ExtraInfo", makeDictionary());
    record();
    EXPECT_THAT(keysOfNewest(), ElementsAre("DisplayState"));
}

TEST_F(History, EntryWithoutExtraInfoHasNoDate)
{
    state.set("DisplayState", makeData({}));
    state.set("Display", makeDictionary());
    record();
    EXPECT_THAT(keysOfNewest(), ElementsAre("DisplayState", "Display"));
}

TEST_F(History, EntryShowsWhatWasShownThen)
{
    const auto cell = makeDictionary({{"Id", "1"}});
    const auto cells = makeArray({cell});
    const auto extra = makeDictionary();
    const auto message = makeDictionary({{"Cells", cells}});
    state.set("DisplayState", message);
    state.set("Display", makeDictionary({{"Cells", cells}}));
    state.set("ExtraInfo", extra);
    record();
    cell->set("Id", "2");
    cells->elements.emplace_back("more");
    extra->set("note", "x");
    message->set("new", "y");

    const Value then = makeDictionary({{"Cells", makeArray({makeDictionary({{"Id", "1"}})})}});
    EXPECT_EQ(newest().at("DisplayState"), then);
    EXPECT_EQ(newest().at("Display"), then);
    EXPECT_EQ(newest().at("ExtraInfo"), Value(makeDictionary()));
}

TEST_F(History, DateIsOfTheMoment)
{
    for (const Label key : {Label("DisplayState"), Label("Display"), Label("ExtraInfo")})
        state.set(key, makeDictionary());
    platform.advance(14h + 29min + 59s + 999ms);
    record();
    EXPECT_EQ(newest().at("Date"), Value("2012-05-04 23:59:59 +0000"));
    platform.advance(1ms);
    record();
    EXPECT_EQ(newest().at("Description"), Value("Snapshot (2012-05-05 00:00:00 +0000)"));
}

} // namespace
} // namespace pelorus::test
