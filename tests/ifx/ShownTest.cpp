#include "tests/model/ModelFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;

/// The model with an IFX baseband.
class ShownIfx : public ModelFixture {
protected:
    ShownIfx() { startWith("IFX"); }

    void receive(std::string_view content)
    {
        platform.deliver(propertyListText(content));
        platform.advance(2s);
    }
    std::vector<std::string> childrenOf(const std::string& path)
    {
        std::vector<std::string> names;
        const auto node = model->nodeAtPath(path);
        if (node && node->childNodes())
            for (const auto& child : *node->childNodes())
                names.push_back(child->displayName());
        return names;
    }
};

TEST_F(ShownIfx, AsksForTheStreamAndNothingElse)
{
    EXPECT_EQ(platform.sent.back().propertyList(), Value(makeDictionary({{"SetState", "Streaming"}})));
}

TEST_F(ShownIfx, IsUnknownBeforeTheFirstMessage)
{
    EXPECT_EQ(shownAt("/"), "(unknown)");
    platform.deliver("nonsense");
    platform.advance(2s);
    EXPECT_EQ(shownAt("/"), "(unknown)");
}

TEST_F(ShownIfx, IsATreeOfTheMessage)
{
    receive("<dict><key>Serving Cell</key><dict><key>ARFCN</key><string>62</string><key>Level</key>"
            "<dict><key>dBm</key><string>-71</string></dict></dict></dict>");
    EXPECT_THAT(childrenOf("/"), ElementsAre("Serving Cell"));
    EXPECT_THAT(childrenOf("/Serving Cell"), ElementsAre("ARFCN", "Level"));
    EXPECT_EQ(shownAt("/Serving Cell/Level"), "-71");
    EXPECT_EQ(shownAt("/Serving Cell/Level/dBm"), "(none)");
}

TEST_F(ShownIfx, NumbersTheElementsOfAnArrayFromItsSecond)
{
    receive("<dict><key>Neighbors</key><array><string>ARFCN</string><string>70</string><dict>"
            "<key>ARFCN</key><string>78</string><key>BSIC</key><string>18</string></dict></array></dict>");
    EXPECT_THAT(childrenOf("/Neighbors"), ElementsAre("0", "1"));
    EXPECT_EQ(shownAt("/Neighbors/0"), "70");
    EXPECT_EQ(shownAt("/Neighbors/1/ARFCN"), "78");
}

TEST_F(ShownIfx, LosesAPathWhoseGroupVanishes)
{
    receive("<dict><key>A</key><dict><key>B</key><string>1</string><key>C</key><string>2</string></dict>"
            "<key>D</key><string>3</string></dict>");
    ASSERT_NE(model->nodeAtPath("/A/C"), nullptr);
    receive("<dict><key>A</key><dict><key>B</key><string>1</string></dict><key>D</key><string>3</string>"
            "</dict>");
    EXPECT_EQ(model->nodeAtPath("/A/C"), nullptr);
    EXPECT_EQ(shownAt("/A"), "1") << "the group is its only row now";
    receive("<dict><key>D</key><string>3</string></dict>");
    EXPECT_EQ(model->nodeAtPath("/A"), nullptr);
    EXPECT_THAT(childrenOf("/"), ElementsAre("D"));
    receive("<string>gone</string>");
    EXPECT_EQ(shownAt("/"), "gone");
    EXPECT_EQ(model->nodeAtPath("/D"), nullptr);
}

TEST_F(ShownIfx, StaysWhenAMessageIsDropped)
{
    receive("<dict><key>A</key><string>1</string></dict>");
    log.take();
    receive("<dict><key>A</key><integer>2</integer></dict>");
    EXPECT_THAT(errors(), ElementsAre("Unknown object of type Integer encountered"));
    EXPECT_EQ(shownAt("/A"), "1");
}

TEST_F(ShownIfx, IsSavedAsItWasReceived)
{
    receive("<dict><key>A</key><dict><key>B</key><string>1</string></dict></dict>");
    model->topLevelNodes();
    const auto contents = model->getSaveContents();
    ASSERT_EQ(contents->elements.size(), 1U) << "no DLF file";
    const Dictionary& entry = *contents->elements.front().dictionary();
    EXPECT_EQ(entry.at("DisplayState"), Value(makeDictionary({{"A", makeDictionary({{"B", "1"}})}})));
    EXPECT_EQ(entry.at("Display"), Value(makeDictionary({{"A", "1"}})));
}

} // namespace
} // namespace pelorus::test
