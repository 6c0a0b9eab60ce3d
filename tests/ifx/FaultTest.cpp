#include "tests/ifx/IfxFixture.h"
#include "tests/platform/BinaryListBuilder.h"

#include <random>

// Messages that are no display: each is logged and dropped, and what was shown before stands.

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class Fault : public IfxFixture {
protected:
    Fault()
    {
        receiveXml("<dict><key>A</key><dict><key>B</key><string>x</string></dict></dict>");
        state.at("ExtraInfo").dictionary()->set("Kept", "yes");
    }

    void expectUntouched() const
    {
        EXPECT_EQ(shown(), "A: x\n");
        EXPECT_EQ(asReceived(), "A:\n  B: x\n");
        EXPECT_EQ(textOf(state.at("ExtraInfo")), "Kept: yes\n");
    }
    void expectNotDeserialized(std::string_view bytes)
    {
        receive(bytes);
        EXPECT_THAT(log.take(), ElementsAre("<3>Could not deserialize the object"));
        expectUntouched();
    }
    void expectUnknown(std::string_view type, std::string_view content)
    {
        receiveXml(content);
        EXPECT_THAT(log.take(), ElementsAre(fmt::format("<3>Unknown object of type {} encountered", type)))
            << content;
        expectUntouched();
    }
};

std::string nested(std::string_view start, std::string_view middle, std::string_view end, std::size_t depth)
{
    std::string text;
    for (std::size_t level = 0; level < depth; ++level)
        text += start;
    text += middle;
    for (std::size_t level = 0; level < depth; ++level)
        text += end;
    return text;
}

TEST_F(Fault, BytesThatAreNoPropertyList)
{
    for (const std::string_view bytes :
         {"", " ", "x", "bplist00", "bplist01x", "<plist>", "<plist></plist>", "<plist><dict/>", "</plist>",
          "<plist version=\"1.0\"><dict><key>A</key></dict></plist>"})
        expectNotDeserialized(bytes);
    expectNotDeserialized(std::string_view("\0\0\0\0", 4));
}

TEST_F(Fault, FormsThatAreNotRead)
{
    expectNotDeserialized("{ A = x; }");
    expectNotDeserialized("( a, b )");
    expectNotDeserialized("{\"A\": \"x\"}");
}

TEST_F(Fault, ListsThatAreCutShort)
{
    const auto list = makeDictionary({{"A", makeArray({"0", "1"})}, {"B", "x"}});
    for (const PropertyListForm form : {PropertyListForm::xml, PropertyListForm::binary}) {
        const std::string whole = serialized(list, form);
        // What is behind the end of the XML element may be missing.
        const std::size_t end = form == PropertyListForm::xml ? whole.find("</plist>") : whole.size();
        for (std::size_t length = 0; length < end; ++length) {
            SCOPED_TRACE(length);
            // Memory of its own size: a sanitizer sees what is read beyond it.
            const std::vector<char> prefix(whole.begin(),
                                           whole.begin() + static_cast<std::ptrdiff_t>(length));
            expectNotDeserialized({prefix.data(), prefix.size()});
        }
    }
}

TEST_F(Fault, RandomBytes)
{
    std::mt19937 random(20120504); // NOLINT(cert-msc51-cpp): repeatable on purpose
    for (int message = 0; message < 2000; ++message) {
        std::string bytes(random() % 200, ' ');
        for (char& byte : bytes)
            byte = static_cast<char>(random());
        if (message % 2 != 0)
            bytes.insert(0, "bplist00");
        expectNotDeserialized(bytes);
    }
}

TEST_F(Fault, ObjectsThatAreNotShownAtTheTop)
{
    expectUnknown("Integer", "<integer>7</integer>");
    expectUnknown("Real", "<real>7.5</real>");
    expectUnknown("Boolean", "<true/>");
    expectUnknown("Date", "<date>2012-05-04T09:30:00Z</date>");
    expectUnknown("Data", "<data>AQI=</data>");
}

TEST_F(Fault, ObjectsThatAreNotShownWithin)
{
    expectUnknown("Integer", "<dict><key>B</key><integer>7</integer></dict>");
    expectUnknown("Real", "<dict><key>B</key><dict><key>C</key><real>1</real></dict></dict>");
    expectUnknown("Data", "<dict><key>B</key><array><string>0</string><data/></array></dict>");
    expectUnknown("Boolean", "<array><string>0</string><dict><key>C</key><false/></dict></array>");
    expectUnknown("Date", "<array><string>0</string><array><string>0</string>"
                          "<date>2012-05-04T09:30:00Z</date></array></array>");
    // The first in the order of the list is the one that is named.
    expectUnknown("Real", "<dict><key>B</key><string>x</string><key>C</key><real>1</real>"
                          "<key>D</key><integer>1</integer></dict>");
}

TEST_F(Fault, ObjectsInBinaryLists)
{
    receive(serialized(makeDictionary({{"B", 7}}), PropertyListForm::binary));
    EXPECT_THAT(log.take(), ElementsAre("<3>Unknown object of type Integer encountered"));
    expectUntouched();
    // A UID, which reads as an integer.
    receive(BinaryListBuilder().dictionary({1}, {2}).string("B").object("\x80\x05").bytes());
    EXPECT_THAT(log.take(), ElementsAre("<3>Unknown object of type Integer encountered"));
    expectUntouched();
}

TEST_F(Fault, IsNoneInTheFirstElementOfAnArrayWhichIsSkippedUnseen)
{
    receiveXml("<dict><key>L</key><array><integer>7</integer><string>1</string></array>"
               "<key>M</key><array><dict><key>C</key><true/></dict></array></dict>");
    EXPECT_THAT(errors(), IsEmpty());
    EXPECT_EQ(shown(), "L:\n  - 1\nM:\n");
    EXPECT_EQ(state.at("DisplayState").dictionary()->at("L").array()->elements.at(0), Value(7));
    generator.generateLogUsingState(state);
    EXPECT_TRUE(serializePropertyList(generator.getSaveContentsFromState(state)));
}

TEST_F(Fault, EndsWithTheMessageThatHasIt)
{
    receive("nonsense");
    receiveXml("<dict><key>B</key><string>y</string></dict>");
    EXPECT_EQ(shown(), "B: y\n");
    EXPECT_EQ(state.at("ExtraInfo"), Value(makeDictionary()));
}

TEST_F(Fault, OfTheFirstMessageLeavesNothingToShow)
{
    State fresh;
    generator.updateState(fresh, bytesOf("nonsense"));
    EXPECT_FALSE(generator.generateLogUsingState(fresh));
    for (const char* key : {"DisplayState", "Display", "ExtraInfo"})
        EXPECT_FALSE(fresh.find(key)) << key;
}

TEST_F(Fault, DepthIsBoundedAndTheDeepestIsShown)
{
    receiveXml(nested("<array><string>0</string>", "<string>x</string>", "</array>", 256));
    EXPECT_THAT(errors(), IsEmpty());
    Value innermost = state.at("Display");
    for (int level = 1; level < 256; ++level) {
        ASSERT_NE(innermost.array(), nullptr);
        ASSERT_EQ(innermost.array()->elements.size(), 1U);
        innermost = Value(innermost.array()->elements.front());
    }
    EXPECT_EQ(textOf(innermost), "- x\n");

    receiveXml(nested("<dict><key>k</key>", "<string>x</string>", "</dict>", 256));
    EXPECT_THAT(errors(), IsEmpty());
    EXPECT_EQ(shown(), "k: x\n");
}

TEST_F(Fault, ListsThatNestDeeper)
{
    for (const std::size_t depth : {257U, 100'000U}) {
        expectNotDeserialized(
            propertyListText(nested("<array><string>0</string>", "<string>x</string>", "</array>", depth)));
        expectNotDeserialized(
            propertyListText(nested("<dict><key>k</key>", "<string>x</string>", "</dict>", depth)));
        BinaryListBuilder list;
        list.referenceSize = 3;
        for (std::uint64_t level = 0; level < depth; ++level)
            list.array({level + 1, level + 1});
        expectNotDeserialized(list.string("x").bytes());
    }
}

} // namespace
} // namespace pelorus::test
