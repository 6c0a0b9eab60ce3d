#include "tests/generator/ProbeFixture.h"
#include "tests/support/SectionFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class Template : public ProbeFixture {
protected:
    void useTemplate(std::string_view content) { platform.addResource("Probe", propertyListText(content)); }
    std::string shown() const { return textOf(state.at("Display")); }
};

// The call that builds the display shows nothing: meant.
TEST_F(Template, FirstCallBuildsTheDisplayAndReturnsNone)
{
    EXPECT_FALSE(generator.getDisplayFromState(state));
    const Value display = generator.getDisplayFromState(state);
    EXPECT_EQ(display.dictionary(), state.at("Display").dictionary());
    EXPECT_EQ(textOf(display), "First:\n  Code: -\nSecond:\n");
    EXPECT_EQ(state.at("ExtraInfo"), Value(makeDictionary()));
    EXPECT_EQ(textOf(state.at("Template")), "First:\n  Code: -\nSecond:\n");
}

TEST_F(Template, FirstGenerationShowsNothing)
{
    EXPECT_FALSE(generator.generateLogUsingState(state));
    EXPECT_TRUE(generator.generateLogUsingState(state));
}

TEST_F(Template, DisplayThatIsThereIsReturned)
{
    state.set("Display", "whatever is there");
    EXPECT_EQ(generator.getDisplayFromState(state), Value("whatever is there"));
}

TEST_F(Template, TemplateThatIsThereIsNotLoadedAgain)
{
    state.set("Template", makeDictionary({{"Second", "x"}}));
    generator.getDisplayFromState(state);
    EXPECT_EQ(shown(), "Second: x\n");
}

TEST_F(Template, BuildingSaysWhatIsBound)
{
    log.take();
    generator.getDisplayFromState(state);
    EXPECT_THAT(logged(), ElementsAre("<4>Initialized class index: %p, Self: %p", "<4>Dictionary = 1",
                                      "<4>String = 0", "<4>First", "<4>Second"));
    generator.getDisplayFromState(state);
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(Template, NamesTheIndexFirst)
{
    log.take();
    generator.getDisplayFromState(state);
    EXPECT_EQ(log.take().front(),
              fmt::sprintf("<4>Initialized class index: %p, Self: %p", static_cast<const void*>(index.get()),
                           static_cast<const void*>(&generator)));
}

TEST_F(Template, SectionsWriteIntoTheDisplay)
{
    generator.updateState(state, packet(1, 0x1234).bytes());
    EXPECT_EQ(shown(), "First:\n  Code: 0x1234\nSecond:\n  Code: 0x1234\n");
    EXPECT_EQ(textOf(state.at("Template")), "First:\n  Code: -\nSecond:\n");
}

TEST_F(Template, SectionsMayStandAtAnyDepth)
{
    useTemplate(
        "<dict><key>Group</key><array><dict><key>Deep</key><dict><key>First</key><dict/></dict></dict>"
        "<string>text</string></array></dict>");
    generator.updateState(state, packet(1, 0x1234).bytes());
    EXPECT_EQ(shown(), "Group:\n  -\n    Deep:\n      First:\n        Code: 0x1234\n  - text\n");
}

TEST_F(Template, SectionMayStandInsideAnother)
{
    useTemplate("<dict><key>First</key><dict><key>Second</key><dict/></dict></dict>");
    log.take();
    generator.updateState(state, packet(1, 0x1234).bytes());
    EXPECT_EQ(shown(), "First:\n  Second:\n    Code: 0x1234\n  Code: 0x1234\n");
    const auto lines = log.take();
    EXPECT_EQ(lines.at(3), "<4>Second"); // the inner value is processed first
    EXPECT_EQ(lines.at(4), "<4>First");
}

TEST_F(Template, OfANameThatOccursTwiceTheLastIsBound)
{
    useTemplate("<dict><key>A</key><dict><key>First</key><dict/></dict>"
                "<key>B</key><dict><key>First</key><dict/></dict></dict>");
    generator.updateState(state, packet(1, 0x1234).bytes());
    EXPECT_EQ(shown(), "A:\n  First:\nB:\n  First:\n    Code: 0x1234\n");
}

TEST_F(Template, SectionThatTheTemplateLacksWritesNowhere)
{
    useTemplate("<dict><key>Second</key><dict/></dict>");
    generator.updateState(state, packet(1, 0x1234).bytes());
    EXPECT_EQ(shown(), "Second:\n  Code: 0x1234\n");
    EXPECT_EQ(received().size(), 1U);
}

TEST_F(Template, NumberEndsTheProcessing)
{
    for (const char* content : {"<dict><key>First</key><integer>1</integer></dict>",
                                "<dict><key>A</key><array><true/></array></dict>",
                                "<dict><key>A</key><date>2012-05-04T09:30:00Z</date></dict>",
                                "<dict><key>A</key><dict><key>B</key><data>AAAA</data></dict></dict>"}) {
        useTemplate(content);
        state.clear();
        log.take();
        EXPECT_THROW(generator.getDisplayFromState(state), std::invalid_argument) << content;
        EXPECT_THAT(logged(), ElementsAre("<4>Initialized class index: %p, Self: %p", "<4>Dictionary = 1",
                                          "<4>String = 0", "<3>Received an object of unknown type",
                                          "<4>Processing the template"));
        EXPECT_FALSE(state.find("Display"));
    }
}

TEST_F(Template, MissingTemplateIsComplainedOfEachTime)
{
    platform.files.clear();
    log.take();
    for (int attempt = 0; attempt < 3; ++attempt) {
        EXPECT_FALSE(generator.getDisplayFromState(state));
        EXPECT_THAT(log.take(), ElementsAre("<3>Cannot load template for display"));
    }
    generator.updateState(state, packet(1, 0x1234).bytes());
    EXPECT_THAT(log.take(), ElementsAre("<3>Cannot load template for display"));
    EXPECT_EQ(received().size(), 1U); // decoded, but shown nowhere
    EXPECT_FALSE(generator.generateLogUsingState(state));
    EXPECT_THAT(log.take(), ElementsAre("<3>Cannot load template for display"));
    EXPECT_FALSE(state.find("Display"));
    EXPECT_FALSE(state.find("ExtraInfo"));
}

TEST_F(Template, UnreadableTemplateIsMissing)
{
    for (const char* content : {"", "no list", "<plist version=\"1.0\"><array/></plist>",
                                "<plist version=\"1.0\"><string>First</string></plist>"}) {
        platform.addResource("Probe", content);
        log.take();
        EXPECT_FALSE(generator.getDisplayFromState(state));
        EXPECT_THAT(log.take(), ElementsAre("<3>Cannot load template for display")) << content;
        EXPECT_FALSE(state.find("Template"));
    }
}

TEST_F(Template, LaterTemplateIsUsed)
{
    platform.files.clear();
    generator.updateState(state, packet(1, 0x1234).bytes());
    useTemplate("<dict><key>First</key><dict/></dict>");
    generator.updateState(state, packet(1, 0x1234).bytes());
    EXPECT_EQ(shown(), "First:\n  Code: 0x1234\n");
}

TEST_F(Template, ProcessedCopySharesNothing)
{
    const auto inner = makeDictionary({{"a", "1"}});
    const auto list = makeArray({inner, "x"});
    const Value copy = generator.processTemplate(makeDictionary({{"list", list}}));
    inner->set("a", "2");
    list->elements.clear();
    EXPECT_EQ(textOf(copy), "list:\n  -\n    a: 1\n  - x\n");
}

TEST_F(Template, PrintDictComplainsOfEveryOtherObject)
{
    log.take();
    OSPLogGenerator2::printDict(makeDictionary(
        {{"a", "text"}, {"b", makeArray({1, "text", makeDictionary({{"c", true}})})}, {"d", Date{}}}));
    EXPECT_THAT(log.take(),
                ElementsAre("<3>Received an object of unknown type", "<3>Received an object of unknown type",
                            "<3>Received an object of unknown type"));
}

TEST_F(Template, GeneratorWithoutAnIndexHasNoDisplay)
{
    UninitialisedGenerator bare(platform);
    log.take();
    EXPECT_FALSE(bare.generateLogUsingState(state));
    EXPECT_THAT(log.take(), ElementsAre("<3>Cannot load template for display"));
    bare.updateState(state, packet(1, 0x1234).bytes());
    EXPECT_FALSE(bare.generateLogUsingState(state));
}

TEST_F(Template, GeneratorWithoutAnIndexProcessesATemplateThatIsThere)
{
    UninitialisedGenerator bare(platform);
    state.set("Template", makeDictionary({{"First", "x"}}));
    bare.getDisplayFromState(state);
    EXPECT_EQ(shown(), "First: x\n");
}

} // namespace
} // namespace pelorus::test
