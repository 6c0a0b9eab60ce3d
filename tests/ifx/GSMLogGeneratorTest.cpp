#include "tests/ifx/IfxFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

using GSMLogGeneratorTest = IfxFixture;

constexpr std::string_view kServingCell =
    "<dict><key>Serving Cell</key><dict><key>Cell</key><dict><key>ARFCN</key><string>62</string>"
    "<key>BSIC</key><string>18</string></dict></dict><key>Neighbors</key><array><string>ARFCN</string>"
    "<string>70</string></array></dict>";

TEST_F(GSMLogGeneratorTest, AsksForTheStreamAndForNoLogCodes)
{
    EXPECT_EQ(generator.getStartCommand(), Value(makeDictionary({{"SetState", "Streaming"}})));
}

TEST_F(GSMLogGeneratorTest, KeepsWhatItReceivedAndShowsItSimplified)
{
    receiveXml(kServingCell);
    EXPECT_THAT(errors(), IsEmpty());
    EXPECT_EQ(asReceived(), "Serving Cell:\n  Cell:\n    ARFCN: 62\n    BSIC: 18\n"
                            "Neighbors:\n  - ARFCN\n  - 70\n");
    EXPECT_EQ(shown(), "Serving Cell:\n  ARFCN: 62\n  BSIC: 18\nNeighbors:\n  - 70\n");
    EXPECT_EQ(state.at("ExtraInfo"), Value(makeDictionary()));
}

TEST_F(GSMLogGeneratorTest, ReplacesAllOfTheMessageBefore)
{
    receiveXml(kServingCell);
    const Value extra = state.at("ExtraInfo");
    extra.dictionary()->set("Left", "over");
    receiveXml("<dict><key>A</key><string>x</string></dict>");
    EXPECT_EQ(shown(), "A: x\n");
    EXPECT_EQ(asReceived(), "A: x\n");
    EXPECT_EQ(state.at("ExtraInfo"), Value(makeDictionary()));
}

TEST_F(GSMLogGeneratorTest, ReadsEveryEncoding)
{
    const auto list =
        makeDictionary({{"A", makeDictionary({{"B", "x"}})}, {"L", makeArray({"0", "\xC3\xA9"})}});
    for (const PropertyListForm form : {PropertyListForm::xml, PropertyListForm::binary}) {
        receiveXml("<dict/>");
        receive(serialized(list, form));
        EXPECT_EQ(shown(), "A: x\nL:\n  - \xC3\xA9\n");
        EXPECT_EQ(state.at("DisplayState"), Value(list));
    }
    receive("<plist version=\"1.0\"><string>bare</string></plist>");
    EXPECT_EQ(shown(), "bare\n");
    EXPECT_THAT(errors(), IsEmpty());
}

TEST_F(GSMLogGeneratorTest, ShowsATopThatIsNoDictionary)
{
    receiveXml("<string>no service</string>");
    EXPECT_EQ(generator.generateLogUsingState(state), Value("no service"));
    receiveXml("<array><string>0</string><string>1</string></array>");
    EXPECT_EQ(shown(), "- 1\n");
    receiveXml("<dict/>");
    EXPECT_EQ(state.at("Display"), Value(makeDictionary()));
    EXPECT_THAT(errors(), IsEmpty());
}

TEST_F(GSMLogGeneratorTest, HasNothingToShowBeforeTheFirstMessage)
{
    EXPECT_FALSE(generator.generateLogUsingState(state));
    EXPECT_EQ(state.at("History"), Value(makeArray({makeDictionary()})));
}

TEST_F(GSMLogGeneratorTest, RecordsWhatItReceivedAndWhatItShows)
{
    receiveXml("<dict><key>A</key><dict><key>B</key><string>x</string></dict></dict>");
    EXPECT_EQ(generator.generateLogUsingState(state).dictionary(), state.at("Display").dictionary());
    const Value entry = state.at("History").array()->elements.at(0);
    EXPECT_EQ(textOf(entry.dictionary()->at("DisplayState")), "A:\n  B: x\n");
    EXPECT_EQ(textOf(entry.dictionary()->at("Display")), "A: x\n");
    EXPECT_EQ(entry.dictionary()->at("ExtraInfo"), Value(makeDictionary()));
    EXPECT_EQ(entry.dictionary()->size(), 5U);
}

TEST_F(GSMLogGeneratorTest, SavesTheHistoryAndNoDlfFile)
{
    for (const char* text : {"1", "2", "3", "4", "5", "6", "7"}) {
        receiveXml(fmt::format("<dict><key>A</key><string>{}</string></dict>", text));
        generator.generateLogUsingState(state);
    }
    const auto contents = generator.getSaveContentsFromState(state);
    std::string saved;
    for (const Value& entry : contents->elements)
        saved += textOf(entry.dictionary()->at("Display"));
    EXPECT_EQ(saved, "A: 3\nA: 4\nA: 5\nA: 6\nA: 7\n");
    EXPECT_NE(contents, state.at("History").sharedArray());
    EXPECT_TRUE(serializePropertyList(contents));
}

TEST_F(GSMLogGeneratorTest, NewOneShowsWhatTheOneBeforeShowed)
{
    receiveXml(kServingCell);
    GSMLogGenerator next(platform);
    EXPECT_EQ(textOf(next.generateLogUsingState(state)),
              "Serving Cell:\n  ARFCN: 62\n  BSIC: 18\nNeighbors:\n  - 70\n");
}

TEST_F(GSMLogGeneratorTest, DropsTheDisplayOfAnotherTechnologyWithItsFirstMessage)
{
    state.set("Display", makeDictionary({{"Other", "x"}}));
    state.set("Template", makeDictionary());
    state.set("Lookup", makeDictionary());
    receiveXml("<dict><key>A</key><string>x</string></dict>");
    EXPECT_EQ(shown(), "A: x\n");
    EXPECT_FALSE(state.find("Template"));
    EXPECT_FALSE(state.find("Lookup"));
}

} // namespace
} // namespace pelorus::test
