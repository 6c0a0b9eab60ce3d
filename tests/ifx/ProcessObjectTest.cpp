#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "platform/InternalInconsistencyException.h"
#include "tests/platform/PropertyListText.h"
#include "tests/support/SectionFixture.h"
#include "tests/support/Texts.h"

#include <gtest/gtest.h>

namespace pelorus::test {
namespace {

Value listed(std::string_view content)
{
    const Value value = parsed(propertyListText(content));
    EXPECT_TRUE(value) << content;
    return value;
}

std::string processed(std::string_view content)
{
    return textOf(GSMLogGenerator::processObject(listed(content)));
}

TEST(ProcessObject, KeepsAString)
{
    EXPECT_EQ(GSMLogGenerator::processObject("x"), Value("x"));
    EXPECT_EQ(GSMLogGenerator::processObject(""), Value(""));
}

TEST(ProcessObject, DropsAGroupOfOneEntryBelowAKey)
{
    EXPECT_EQ(processed("<dict><key>A</key><dict><key>B</key><string>x</string></dict>"
                        "<key>C</key><string>y</string></dict>"),
              "A: x\nC: y\n");
}

TEST(ProcessObject, KeepsAGroupOfTwoEntries)
{
    EXPECT_EQ(processed("<dict><key>A</key><dict><key>B</key><string>x</string>"
                        "<key>C</key><string>y</string></dict></dict>"),
              "A:\n  B: x\n  C: y\n");
}

TEST(ProcessObject, KeepsAnEmptyGroup)
{
    EXPECT_EQ(processed("<dict><key>A</key><dict/></dict>"), "A:\n");
}

TEST(ProcessObject, KeepsTheOneEntryOfTheTop)
{
    EXPECT_EQ(processed("<dict><key>A</key><string>x</string></dict>"), "A: x\n");
    EXPECT_EQ(processed("<dict><key>A</key><dict><key>B</key><string>x</string></dict></dict>"), "A: x\n");
}

TEST(ProcessObject, DropsGroupsOfOneEntryOneWithinTheOther)
{
    EXPECT_EQ(processed("<dict><key>A</key><dict><key>B</key><dict><key>C</key><dict><key>D</key>"
                        "<string>x</string></dict></dict></dict></dict>"),
              "A: x\n");
}

TEST(ProcessObject, DropsAGroupThatHasOneEntryWhichIsAGroup)
{
    EXPECT_EQ(processed("<dict><key>A</key><dict><key>B</key><dict><key>C</key><string>x</string>"
                        "<key>D</key><string>y</string></dict></dict></dict>"),
              "A:\n  C: x\n  D: y\n");
}

TEST(ProcessObject, DropsAGroupThatHasOneEntryWhichIsAnArray)
{
    EXPECT_EQ(processed("<dict><key>A</key><dict><key>B</key><array><string>0</string><string>1</string>"
                        "</array></dict></dict>"),
              "A:\n  - 1\n");
}

TEST(ProcessObject, CountsTheMarkOfASortedGroupAsAnEntry)
{
    EXPECT_EQ(processed("<dict><key>A</key><dict><key>_sorted</key><string>1</string>"
                        "<key>1;B</key><string>x</string></dict></dict>"),
              "A:\n  _sorted: 1\n  1;B: x\n");
}

TEST(ProcessObject, NeverShowsTheFirstElementOfAnArray)
{
    EXPECT_EQ(processed("<array><string>a</string><string>b</string><string>c</string></array>"),
              "- b\n- c\n");
}

TEST(ProcessObject, LeavesNothingOfAnArrayOfOne)
{
    const Value alone = GSMLogGenerator::processObject(listed("<array><string>a</string></array>"));
    ASSERT_NE(alone.array(), nullptr);
    EXPECT_EQ(alone.array()->elements.size(), 0U);
    const Value none = GSMLogGenerator::processObject(listed("<array/>"));
    ASSERT_NE(none.array(), nullptr);
    EXPECT_EQ(none.array()->elements.size(), 0U);
}

TEST(ProcessObject, SkipsTheFirstElementOfInnerArraysToo)
{
    EXPECT_EQ(processed("<dict><key>A</key><array><string>0</string><array><string>0</string>"
                        "<string>1</string></array></array></dict>"),
              "A:\n  -\n    - 1\n");
}

TEST(ProcessObject, DropsAGroupOfOneEntryWithinAnArray)
{
    EXPECT_EQ(processed("<array><string>0</string><dict><key>A</key><string>x</string></dict>"
                        "<dict><key>A</key><string>x</string><key>B</key><string>y</string></dict></array>"),
              "- x\n-\n  A: x\n  B: y\n");
}

TEST(ProcessObject, KeepsTheOrderOfKeys)
{
    EXPECT_EQ(processed("<dict><key>b</key><string>1</string><key>a</key><string>2</string>"
                        "<key>c</key><string>3</string></dict>"),
              "b: 1\na: 2\nc: 3\n");
}

TEST(ProcessObject, MakesContainersOfItsOwn)
{
    const Value original = listed("<dict><key>A</key><array><string>0</string><dict/></array></dict>");
    const Value shown = GSMLogGenerator::processObject(original);
    shown.dictionary()->at("A").array()->elements.at(0).dictionary()->set("New", "x");
    shown.dictionary()->set("New", "x");
    EXPECT_EQ(textOf(original), "A:\n  - 0\n  -\n");
}

/// The text, the method, the file and the line that the assertion names.
std::string assertion(const Value& object)
{
    try {
        GSMLogGenerator::processObject(object);
    } catch (const InternalInconsistencyException& failure) {
        return fmt::format("{} {} {} {}", failure.what(), failure.method, failure.file, failure.line);
    }
    return "none";
}

TEST(ProcessObject, AssertsThatItKnowsTheType)
{
    constexpr std::string_view place = " processObject: LogGenerator/GSM/GSMLogGenerator 78";
    const auto expected = [&](std::string_view type) {
        return fmt::format("Unknown object of type {} encountered{}", type, place);
    };
    EXPECT_EQ(assertion(listed("<integer>7</integer>")), expected("Integer"));
    EXPECT_EQ(assertion(listed("<real>7.5</real>")), expected("Real"));
    EXPECT_EQ(assertion(listed("<true/>")), expected("Boolean"));
    EXPECT_EQ(assertion(listed("<false/>")), expected("Boolean"));
    EXPECT_EQ(assertion(listed("<date>2012-05-04T09:30:00Z</date>")), expected("Date"));
    EXPECT_EQ(assertion(listed("<data>AQI=</data>")), expected("Data"));
    EXPECT_EQ(assertion(Value()), expected("Nil"));
}

TEST(CanCollapse, GivesTheOnlyValueOfADictionary)
{
    EXPECT_EQ(GSMLogGenerator::canCollapse(makeDictionary({{"A", "x"}})), Value("x"));
    const Value inner = makeDictionary({{"B", "x"}});
    EXPECT_EQ(GSMLogGenerator::canCollapse(makeDictionary({{"A", inner}})).dictionary(), inner.dictionary());
}

TEST(CanCollapse, GivesNothingForAnyOtherObject)
{
    EXPECT_FALSE(GSMLogGenerator::canCollapse(makeDictionary()));
    EXPECT_FALSE(GSMLogGenerator::canCollapse(makeDictionary({{"A", "x"}, {"B", "y"}})));
    EXPECT_FALSE(GSMLogGenerator::canCollapse(makeArray({"x"})));
    EXPECT_FALSE(GSMLogGenerator::canCollapse("x"));
    EXPECT_FALSE(GSMLogGenerator::canCollapse(Value()));
}

} // namespace
} // namespace pelorus::test
