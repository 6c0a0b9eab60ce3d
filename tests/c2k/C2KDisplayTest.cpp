#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "LogGenerator/Osprey/LTE/LTELogGenerator.h"
#include "tests/generator/GeneratorFixture.h"
#include "tests/support/SectionFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr const char* kTwoGroups = "<dict><key>_sorted</key><string>_sorted</string>"
                                   "<key>02;B</key><dict><key>Color</key><string>kColorCode</string>"
                                   "<key>Never</key><string>kNobodyPublishesThis</string></dict>"
                                   "<key>01;A</key><string>kColorCode</string></dict>";

/// How the template becomes the display.
class C2KDisplay : public GeneratorFixture {
protected:
    void setTemplate(std::string_view content)
    {
        platform.addResource("C2KTemplate", propertyListText(content));
    }
    void receiveColor(C2KLogGenerator& to, unsigned color)
    {
        to.updateState(state, PacketBuilder(50).u8(0, 1).u16(3, 0x1183).u8(41, color).bytes());
    }
    std::string shown() { return textOf(state.at("Display")); }

    C2KLogGenerator generator{platform};
};

TEST_F(C2KDisplay, HasTheShapeOfTheTemplateAndEmptyRows)
{
    setTemplate(kTwoGroups);
    const Value display = generator.getDisplayFromState(state);
    EXPECT_EQ(textOf(display), "_sorted: _sorted\n"
                               "02;B:\n  Color: \n  Never: \n"
                               "01;A: \n");
    EXPECT_EQ(display.dictionary(), state.at("Display").dictionary());
    EXPECT_EQ(generator.getDisplayFromState(state).dictionary(), display.dictionary());
    EXPECT_TRUE(state.at("Template").dictionary()->find("01;A"));
    EXPECT_TRUE(state.at("ExtraInfo").dictionary()->empty());
}

TEST_F(C2KDisplay, NotesTheRowsOfEachKeyInTheirOrder)
{
    setTemplate(kTwoGroups);
    const Value display = generator.getDisplayFromState(state);
    const Dictionary& lookup = *state.at("Lookup").dictionary();
    EXPECT_EQ(lookup.size(), 2U);
    const auto& rows = lookup.at("kColorCode").array()->elements;
    ASSERT_EQ(rows.size(), 2U);
    EXPECT_EQ(rows[0].dictionary()->at("key"), Value("Color"));
    EXPECT_EQ(rows[0].dictionary()->at("dict").dictionary(), display.dictionary()->at("02;B").dictionary());
    EXPECT_EQ(rows[1].dictionary()->at("key"), Value("01;A"));
    EXPECT_EQ(rows[1].dictionary()->at("dict").dictionary(), display.dictionary());
    EXPECT_EQ(lookup.at("kNobodyPublishesThis").array()->elements.size(), 1U);
}

TEST_F(C2KDisplay, ShowsAValueInEveryRowOfItsKey)
{
    setTemplate(kTwoGroups);
    receiveColor(generator, 42);
    EXPECT_EQ(shown(), "_sorted: _sorted\n02;B:\n  Color: 42\n  Never: \n01;A: 42\n");
    receiveColor(generator, 43);
    EXPECT_EQ(shown(), "_sorted: _sorted\n02;B:\n  Color: 43\n  Never: \n01;A: 43\n");
}

TEST_F(C2KDisplay, ShowsOneAndTheSameListInEveryRowOfItsKey)
{
    setTemplate("<dict><key>A</key><string>kActiveSetPilots</string>"
                "<key>B</key><string>kActiveSetPilots</string></dict>");
    generator.updateState(
        state, PacketBuilder(37).u8(0, 1).u16(3, 0x12B6).u8(15, 1).u16(25, 5).u16(27, 512).bytes());
    EXPECT_EQ(shown(), "A:\n  _sorted: _sorted\n  0;5: +0.00 dB\n"
                       "B:\n  _sorted: _sorted\n  0;5: +0.00 dB\n");
    EXPECT_EQ(state.at("Display").dictionary()->at("A").dictionary(),
              state.at("Display").dictionary()->at("B").dictionary());
}

TEST_F(C2KDisplay, PassesOverWhatIsNeitherGroupNorText)
{
    setTemplate(
        "<dict><key>Number</key><integer>1</integer><key>Array</key><array><string>kColorCode</string>"
        "</array><key>True</key><true/><key>Data</key><data></data>"
        "<key>Color</key><string>kColorCode</string><key>Empty</key><dict/></dict>");
    generator.getDisplayFromState(state);
    EXPECT_EQ(shown(), "Color: \nEmpty:\n");
    EXPECT_EQ(state.at("Lookup").dictionary()->size(), 1U);
    EXPECT_EQ(state.at("Lookup").dictionary()->at("kColorCode").array()->elements.size(), 1U);
}

// The mark is known by its text, whatever its key.
TEST_F(C2KDisplay, TakesOverEveryMark)
{
    setTemplate(
        "<dict><key>Other</key><string>_sorted</string><key>_sorted</key><string>kColorCode</string></dict>");
    receiveColor(generator, 7);
    EXPECT_EQ(shown(), "Other: _sorted\n_sorted: 7\n");
}

TEST_F(C2KDisplay, LogsOneLineForEveryGroup)
{
    setTemplate("<dict><key>A</key><dict><key>B</key><dict/></dict><key>C</key><dict/></dict>");
    log.take();
    generator.getDisplayFromState(state);
    EXPECT_THAT(log.take(), ElementsAre("<4>Processing the template", "<4>Processing the template",
                                        "<4>Processing the template", "<4>Processing the template"));
    generator.getDisplayFromState(state);
    EXPECT_THAT(log.take(), IsEmpty());
    C2KLogGenerator::processTemplate(Dictionary(), makeDictionary(), *makeDictionary());
    EXPECT_THAT(log.take(), ElementsAre("<4>Processing the template"));
}

TEST_F(C2KDisplay, WithoutTemplateShowsNothingButKeepsPacketsAndTriesAgain)
{
    log.take();
    receiveColor(generator, 7);
    EXPECT_THAT(log.take(), ElementsAre("<3>Cannot load C2K template for display"));
    EXPECT_FALSE(state.find("Display"));
    EXPECT_FALSE(state.find("Template"));
    generator.updateState(state, PacketBuilder(49).u8(0, 1).u16(3, 0x1183).bytes());
    EXPECT_THAT(log.take(), ElementsAre("<3>Cannot load C2K template for display",
                                        "<3>Log code 0x1183 is 49 bytes long but should be 50 bytes."));
    EXPECT_FALSE(generator.generateLogUsingState(state));
    EXPECT_THAT(log.take(), ElementsAre("<3>Cannot load C2K template for display"));
    EXPECT_EQ(state.at("DisplayState").data()->size(), 99U);
    EXPECT_EQ(state.at("History").array()->elements.size(), 1U);
    setTemplate(kTwoGroups);
    receiveColor(generator, 8);
    EXPECT_EQ(shown(), "_sorted: _sorted\n02;B:\n  Color: 8\n  Never: \n01;A: 8\n");
}

TEST_F(C2KDisplay, WithoutTemplateTheRunningQuantitiesGoOn)
{
    generator.updateState(state, PacketBuilder(241).u8(0, 1).u16(3, 0x1192).u32(13, 5).bytes());
    generator.updateState(state, PacketBuilder(241).u8(0, 1).u16(3, 0x1192).u32(13, 6).bytes());
    EXPECT_EQ(state.at("FLDataSeqNum"), Value(6));
    EXPECT_FALSE(state.find("ExtraInfo"));
}

TEST_F(C2KDisplay, TemplateThatIsNoDictionaryIsNone)
{
    setTemplate("<array/>");
    log.take();
    EXPECT_FALSE(generator.getDisplayFromState(state));
    platform.addResource("C2KTemplate", "no property list");
    EXPECT_FALSE(generator.getDisplayFromState(state));
    EXPECT_THAT(log.take(), ElementsAre("<3>Cannot load C2K template for display",
                                        "<3>Cannot load C2K template for display"));
}

TEST_F(C2KDisplay, GoesOnUnderTheNextGenerator)
{
    setTemplate(kTwoGroups);
    receiveColor(generator, 42);
    const auto display = state.at("Display").sharedDictionary();
    C2KLogGenerator next(platform);
    log.take();
    EXPECT_EQ(next.generateLogUsingState(state).dictionary(), display.get());
    EXPECT_EQ(shown(), "_sorted: _sorted\n02;B:\n  Color: 42\n  Never: \n01;A: 42\n");
    receiveColor(next, 43);
    EXPECT_EQ(state.at("Display").sharedDictionary(), display);
    EXPECT_EQ(shown(), "_sorted: _sorted\n02;B:\n  Color: 43\n  Never: \n01;A: 43\n");
    EXPECT_THAT(log.take(), IsEmpty()); // the template is not processed again
}

TEST_F(C2KDisplay, ReplacesThatOfAnotherTechnology)
{
    setTemplate(kTwoGroups);
    platform.addResource("LTE", propertyListText("<dict><key>LTE</key><dict/></dict>"));
    LTELogGenerator other(platform);
    other.generateLogUsingState(state);
    receiveColor(generator, 42);
    EXPECT_EQ(shown(), "_sorted: _sorted\n02;B:\n  Color: 42\n  Never: \n01;A: 42\n");
    EXPECT_EQ(state.at("History").array()->elements.size(), 1U);
    LTELogGenerator back(platform);
    back.generateLogUsingState(state);
    EXPECT_EQ(shown(), "LTE:\n");
    EXPECT_FALSE(state.find("Lookup"));
}

} // namespace
} // namespace pelorus::test
