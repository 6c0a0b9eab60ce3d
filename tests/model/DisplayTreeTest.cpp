#include "model/PelorusModelNode.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;
using testing::UnorderedElementsAre;

class DisplayTree : public testing::Test {
protected:
    void build(const Value& display) { root = PelorusModelNode::makeTreeFromObject(display, paths); }
    /// "name=value" of each child of a node, an inner node without "=value".
    std::vector<std::string> childrenAt(const std::string& path) const
    {
        std::vector<std::string> texts;
        for (const auto& child : *paths.at(path)->childNodes())
            texts.push_back(child->displayName() + (child->value() ? "=" + *child->value() : ""));
        return texts;
    }
    std::vector<std::string> allPaths() const
    {
        std::vector<std::string> texts;
        for (const auto& entry : paths)
            texts.push_back(entry.first);
        return texts;
    }

    std::shared_ptr<const PelorusModelNode> root;
    PathDictionary paths;
};

TEST_F(DisplayTree, RootIsNamedPelorus)
{
    build(makeDictionary({{"GSM", makeDictionary({{"Cell", "1"}})}}));
    EXPECT_EQ(root->displayName(), "Pelorus");
    EXPECT_EQ(paths.at("/"), root);
    EXPECT_THAT(allPaths(), UnorderedElementsAre("/", "/GSM", "/GSM/Cell"));
    EXPECT_EQ(paths.at("/GSM"), root->childNodes()->front());
}

TEST_F(DisplayTree, SortedDictionaryShowsWhatFollowsTheSemicolon)
{
    build(makeDictionary({{"_sorted", "1"}, {"2;B", "x"}, {"1;A", "y"}}));
    EXPECT_THAT(childrenAt("/"), ElementsAre("A=y", "B=x"));
    EXPECT_THAT(allPaths(), UnorderedElementsAre("/", "/A", "/B"));
}

TEST_F(DisplayTree, UnsortedDictionaryShowsKeysWhole)
{
    build(makeDictionary({{"2;B", "x"}, {"1;A", "y"}}));
    EXPECT_THAT(childrenAt("/"), ElementsAre("2;B=x", "1;A=y"));
    EXPECT_THAT(allPaths(), UnorderedElementsAre("/", "/2;B", "/1;A"));
}

TEST_F(DisplayTree, SortMarkMayHaveAnyValue)
{
    for (const Value& mark : {Value(""), Value("no"), Value(false), Value(0), Value(makeDictionary())}) {
        build(makeDictionary({{"b", "2"}, {"_sorted", mark}, {"a", "1"}}));
        EXPECT_THAT(childrenAt("/"), ElementsAre("a=1", "b=2"));
    }
}

TEST_F(DisplayTree, SortsByCharacterNotByNumber)
{
    build(makeDictionary({{"_sorted", "1"}, {"2;b", "x"}, {"10;a", "y"}, {"b", "z"}, {"B", "w"}, {"", "v"}}));
    EXPECT_THAT(childrenAt("/"), ElementsAre("=v", "a=y", "b=x", "B=w", "b=z"));
}

TEST_F(DisplayTree, SplitsOnlyAtASingleSemicolon)
{
    build(makeDictionary(
        {{"_sorted", "1"}, {"1;a;b", "x"}, {"2;", "y"}, {";c", "z"}, {"3", "w"}, {";;", "v"}}));
    EXPECT_THAT(childrenAt("/"), ElementsAre("1;a;b=x", "=y", "3=w", ";;=v", "c=z"));
}

TEST_F(DisplayTree, SortMarkCountsForItsOwnDictionaryOnly)
{
    build(makeDictionary({{"_sorted", "1"}, {"1;In", makeDictionary({{"2;b", "x"}, {"1;a", "y"}})}}));
    EXPECT_THAT(childrenAt("/In"), ElementsAre("2;b=x", "1;a=y"));
}

TEST_F(DisplayTree, ArrayElementsAreNumbered)
{
    build(makeArray({"a", "b"}));
    EXPECT_THAT(childrenAt("/"), ElementsAre("0=a", "1=b"));
    EXPECT_THAT(allPaths(), UnorderedElementsAre("/", "/0", "/1"));
}

TEST_F(DisplayTree, ArrayOfRowsInsideASection)
{
    build(makeDictionary(
        {{"Cells", makeArray({makeDictionary({{"Id", "1"}}), makeDictionary({{"Id", "2"}})})}}));
    EXPECT_THAT(childrenAt("/Cells"), ElementsAre("0", "1"));
    EXPECT_THAT(childrenAt("/Cells/1"), ElementsAre("Id=2"));
}

TEST_F(DisplayTree, SiblingsOfOneNameAreAllShownAndTheLastIsFound)
{
    build(makeDictionary({{"_sorted", "1"}, {"02;Band", "second"}, {"01;Band", "first"}}));
    EXPECT_THAT(childrenAt("/"), ElementsAre("Band=first", "Band=second"));
    EXPECT_EQ(*paths.at("/Band")->value(), "second");
    EXPECT_THAT(paths, SizeIs(2));
}

TEST_F(DisplayTree, NameKeepsItsSlash)
{
    build(makeDictionary({{"Ec/Io", makeDictionary({{"a/b", "x"}})}}));
    EXPECT_THAT(allPaths(), UnorderedElementsAre("/", "/Ec/Io", "/Ec/Io/a/b"));
    EXPECT_EQ(paths.at("/Ec/Io")->displayName(), "Ec/Io");
}

TEST_F(DisplayTree, WhatIsNoTextOrContainerIsUnknown)
{
    build(makeArray({1, 2.5, true, Date{}, makeData({std::byte{1}})}));
    EXPECT_THAT(childrenAt("/"),
                ElementsAre("0=(unknown)", "1=(unknown)", "2=(unknown)", "3=(unknown)", "4=(unknown)"));
}

TEST_F(DisplayTree, NilObjectGivesAnUnknownRoot)
{
    build(Value());
    EXPECT_EQ(root->displayName(), "Pelorus");
    EXPECT_EQ(*root->value(), "(unknown)");
    EXPECT_EQ(root->childNodes(), nullptr);
    EXPECT_THAT(allPaths(), UnorderedElementsAre("/"));
}

TEST_F(DisplayTree, TextGivesARootThatIsALeaf)
{
    build("nothing yet");
    EXPECT_EQ(*root->value(), "nothing yet");
    EXPECT_EQ(root->childNodes(), nullptr);
}

TEST_F(DisplayTree, EmptyContainersAreInnerNodes)
{
    build(makeDictionary(
        {{"d", makeDictionary()}, {"a", makeArray()}, {"s", makeDictionary({{"_sorted", "1"}})}}));
    for (const char* path : {"/d", "/a", "/s"}) {
        EXPECT_THAT(*paths.at(path)->childNodes(), IsEmpty());
        EXPECT_EQ(paths.at(path)->value(), nullptr);
    }
}

TEST_F(DisplayTree, KeyWithoutAValueIsDropped)
{
    auto display = makeDictionary({{"a", "1"}});
    display->slot(Key("nothing"));
    build(display);
    EXPECT_THAT(childrenAt("/"), ElementsAre("a=1"));

    display->set("_sorted", "1");
    build(display);
    EXPECT_THAT(childrenAt("/"), ElementsAre("a=1"));
}

TEST_F(DisplayTree, SortMarkWithoutAValueIsNone)
{
    auto display = makeDictionary({{"b", "2"}, {"a", "1"}});
    display->slot(Key("_sorted"));
    build(display);
    EXPECT_THAT(childrenAt("/"), ElementsAre("b=2", "a=1"));
}

TEST_F(DisplayTree, TreeDoesNotFollowTheDisplay)
{
    const auto display = makeDictionary({{"a", "1"}});
    build(display);
    display->set("a", "2");
    EXPECT_EQ(*paths.at("/a")->value(), "1");
}

TEST_F(DisplayTree, IsTheSameWithoutAnIndex)
{
    const auto root = PelorusModelNode::makeTreeFromObject(
        makeDictionary({{"Cells", makeArray({makeDictionary({{"PCI", "31"}})})}, {"Empty", makeArray()}}));
    EXPECT_EQ(root->displayName(), "Pelorus");
    ASSERT_THAT(*root->childNodes(), SizeIs(2));
    const auto& cell = root->childNodes()->front()->childNodes()->front();
    EXPECT_EQ(cell->displayName(), "0");
    EXPECT_EQ(*cell->childNodes()->front()->value(), "31");
    EXPECT_THAT(*root->childNodes()->back()->childNodes(), SizeIs(0));
}

TEST_F(DisplayTree, HoldsDeepDisplays)
{
    Value display = "deep";
    std::string path;
    for (int level = 0; level < 256; ++level) {
        display = makeDictionary({{"in", display}});
        path += "/in";
    }
    build(display);
    EXPECT_EQ(*paths.at(path)->value(), "deep");
    EXPECT_THAT(paths, SizeIs(257));
}

} // namespace
} // namespace pelorus::test
