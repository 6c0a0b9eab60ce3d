#include "LogGenerator/Osprey/ListRewriter.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>
#include <set>

namespace pelorus::test {
namespace {

const Dictionary* dictionaryAt(const Array& list, std::size_t index)
{
    return list.elements.at(index).dictionary();
}

TEST(ListRewriter, FillsTheDictionariesOfTheOldListAgain)
{
    Array list;
    ListRewriter rewriter;
    const auto fill = [](std::size_t index, RowWriter& rows) {
        rows.next("Index").text() = std::to_string(index);
        return true;
    };
    rewriter.rewriteRows(list, 2, fill);
    const std::set<const Dictionary*> before{dictionaryAt(list, 0), dictionaryAt(list, 1)};
    rewriter.rewriteRows(list, 2, fill);
    EXPECT_EQ((std::set<const Dictionary*>{dictionaryAt(list, 0), dictionaryAt(list, 1)}), before);
    EXPECT_EQ(textOf(list.elements[0]) + textOf(list.elements[1]), "Index: 0\nIndex: 1\n");
}

TEST(ListRewriter, DropsRowsThatAreNotWrittenAgain)
{
    Array list;
    ListRewriter rewriter;
    rewriter.rewriteRows(list, 1, [](std::size_t, RowWriter& rows) {
        rows.next("A") = "1";
        rows.next("B") = "2";
        return true;
    });
    rewriter.rewriteRows(list, 1, [](std::size_t, RowWriter& rows) {
        rows.next("B") = "3";
        return true;
    });
    EXPECT_EQ(textOf(list.elements.at(0)), "B: 3\n");
}

TEST(ListRewriter, LeavesOutWhatTheFilterRejectsAndUsesItsMemoryForTheNext)
{
    Array list;
    ListRewriter rewriter;
    const Dictionary* rejected = nullptr;
    rewriter.rewriteRows(list, 2, [&](std::size_t index, RowWriter& rows) {
        rows.next(index == 0 ? Label("Rejected") : Label("Kept")) = "x";
        return index == 1;
    });
    ASSERT_EQ(list.elements.size(), 1U);
    EXPECT_EQ(textOf(list.elements[0]), "Kept: x\n");
    rejected = dictionaryAt(list, 0);
    rewriter.rewriteRows(list, 1, [](std::size_t, RowWriter&) { return false; });
    EXPECT_TRUE(list.elements.empty());
    rewriter.rewriteRows(list, 1, [](std::size_t, RowWriter&) { return true; });
    EXPECT_EQ(dictionaryAt(list, 0), rejected);
    EXPECT_EQ(textOf(list.elements[0]), "");
}

TEST(ListRewriter, DoesNotTouchADictionaryThatSomebodyElseHolds)
{
    Array list;
    ListRewriter rewriter;
    const auto fill = [](const char* text) {
        return [text](std::size_t, RowWriter& rows) {
            rows.next("Text") = text;
            return true;
        };
    };
    rewriter.rewriteRows(list, 1, fill("old"));
    const Value held = list.elements[0];
    rewriter.rewriteRows(list, 1, fill("new"));
    EXPECT_EQ(textOf(held), "Text: old\n");
    EXPECT_EQ(textOf(list.elements.at(0)), "Text: new\n");
}

TEST(ListRewriter, MakesListsOfTexts)
{
    Array list;
    list.elements.emplace_back(makeDictionary());
    ListRewriter rewriter;
    rewriter.rewriteTexts(list, 2,
                          [](std::size_t index, std::string& text) { text = std::to_string(index); });
    EXPECT_EQ(Value(makeArray(list.elements)), Value(makeArray({"0", "1"})));
    rewriter.rewriteTexts(list, 0, [](std::size_t, std::string&) {});
    EXPECT_TRUE(list.elements.empty());
}

} // namespace
} // namespace pelorus::test
