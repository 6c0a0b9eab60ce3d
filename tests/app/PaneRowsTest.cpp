#include "app/content/PaneRows.h"

#include <gtest/gtest.h>

namespace pelorus::test {
namespace {

std::shared_ptr<const PelorusModelNode> treeOf(const Value& object)
{
    PathDictionary paths;
    return PelorusModelNode::makeTreeFromObject(object, paths);
}

TEST(PaneRows, AreNoneWithoutANodeAndForALeaf)
{
    EXPECT_EQ(PaneRows().count(), 0);
    EXPECT_EQ(PaneRows(treeOf("text")).count(), 0);
    EXPECT_EQ(PaneRows(treeOf("text")).text(), "");
}

TEST(PaneRows, AreFoundByNameWhereverTheyAre)
{
    const PaneRows rows(treeOf(makeDictionary({{"Band", "3"}, {"PCI", "12"}})));
    EXPECT_EQ(rows.find("Band"), 0);
    EXPECT_EQ(rows.find("PCI"), 1);
    EXPECT_EQ(rows.find("TAC"), std::nullopt);
    EXPECT_EQ(PaneRows(treeOf(makeDictionary({{"TAC", "1"}, {"PCI", "12"}, {"Band", "3"}}))).find("Band"), 2);
}

TEST(PaneRows, OfTheSameNameAreToldApart)
{
    const PaneRows rows(
        treeOf(makeDictionary({{"_sorted", "1"}, {"01;Band", "3"}, {"02;Band", "7"}, {"03;Band", "20"}})));
    ASSERT_EQ(rows.count(), 3);
    for (int row = 0; row < 3; ++row)
        EXPECT_EQ(rows.find(rows.identityOf(row)), row);
}

TEST(PaneRows, OfTheSameNameAreToldApartFromNamesLikeTheirs)
{
    const PaneRows rows(
        treeOf(makeDictionary({{"_sorted", "1"}, {"01;Band", "3"}, {"02;Band\n1", "7"}, {"03;Band", "20"}})));
    ASSERT_EQ(rows.count(), 3);
    for (int row = 0; row < 3; ++row)
        EXPECT_EQ(rows.find(rows.identityOf(row)), row);
}

TEST(PaneRows, AreCopiedAsTextWithAllThatIsBelow)
{
    const PaneRows rows(treeOf(makeDictionary(
        {{"Serving", makeDictionary({{"PCI", "12"}, {"Cells", makeArray({"a"})}})}, {"State", "Idle"}})));
    EXPECT_EQ(rows.text(), "Serving\n  PCI: 12\n  Cells\n    0: a\nState: Idle\n");
    EXPECT_EQ(rows.textOf(0), "Serving\n  PCI: 12\n  Cells\n    0: a");
    EXPECT_EQ(rows.textOf(1), "State: Idle");
}

} // namespace
} // namespace pelorus::test
