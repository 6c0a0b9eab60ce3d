#include "app/content/CellLayout.h"

#include <gtest/gtest.h>
#include <ostream>

namespace pelorus {

void PrintTo(const Rect& rect, std::ostream* stream)
{
    *stream << "(" << rect.x << ", " << rect.y << ", " << rect.width << ", " << rect.height << ")";
}

namespace test {
namespace {

constexpr Rect kBounds{0, 0, 320, 50};

TEST(CellLayout, PutsAnInnerNodesNameTenPointsFromTheLeftAndInTheMiddle)
{
    EXPECT_EQ(keyFrame(kBounds, {100, 18}), (Rect{10, 16, 100, 18}));
    EXPECT_EQ(keyFrame({5, 7, 320, 50}, {100, 18}), (Rect{15, 16, 100, 18}));
}

TEST(CellLayout, PutsAValueThatFitsFlushWithTheRightEdge)
{
    const LeafLayout layout = leafLayout(kBounds, {100, 18}, {60, 20});
    EXPECT_EQ(layout.key, (Rect{10, 16, 100, 18}));
    EXPECT_EQ(layout.value, (Rect{260, 15, 60, 20}));
    EXPECT_EQ(layout.contentSize, (Size{320, 50}));
    EXPECT_EQ(layout.scrollView, (Rect{0, 0, 320, 50}));
}

TEST(CellLayout, PutsAValueThatJustFitsFlushWithTheRightEdge)
{
    const LeafLayout layout = leafLayout(kBounds, {100, 18}, {159, 18}); // needs 319
    EXPECT_EQ(layout.value, (Rect{161, 16, 159, 18}));
    EXPECT_EQ(layout.contentSize, (Size{320, 50}));
}

TEST(CellLayout, PutsAValueThatNeedsTheVeryWidthBehindTheGapAndDoesNotScroll)
{
    const LeafLayout layout = leafLayout(kBounds, {100, 18}, {160, 18});
    EXPECT_EQ(layout.value, (Rect{160, 16, 160, 18}));
    EXPECT_EQ(layout.contentSize, (Size{320, 50}));
}

TEST(CellLayout, ScrollsAValueThatDoesNotFit)
{
    const LeafLayout layout = leafLayout(kBounds, {100, 18}, {160.5, 18});
    EXPECT_EQ(layout.value, (Rect{160, 16, 160.5, 18}));
    EXPECT_EQ(layout.contentSize, (Size{580.5, 50}));
    EXPECT_EQ(layout.scrollView, (Rect{0, 0, 320, 50}));
}

TEST(CellLayout, CountsFromWhereTheBoundsAre)
{
    const LeafLayout fits = leafLayout({5, 7, 320, 50}, {100, 18}, {60, 18});
    EXPECT_EQ(fits.value, (Rect{260, 16, 60, 18})); // the width less the value's, wherever the bounds begin
    const LeafLayout scrolls = leafLayout({5, 7, 320, 50}, {100, 18}, {300, 18});
    EXPECT_EQ(scrolls.key, (Rect{15, 16, 100, 18}));
    EXPECT_EQ(scrolls.value, (Rect{165, 16, 300, 18}));
    EXPECT_EQ(scrolls.scrollView, (Rect{5, 7, 320, 50}));
}

TEST(CellLayout, TellsTheVeryWidthFromLessWhereTheBoundsDoNotBeginAtTheLeft)
{
    EXPECT_EQ(leafLayout({5, 0, 320, 50}, {100, 18}, {159, 18}).value.x, 161); // flush with the width
    EXPECT_EQ(leafLayout({5, 0, 320, 50}, {100, 18}, {160, 18}).value.x, 165); // behind the gap
}

TEST(CellLayout, KeepsTheStripFiftyHighInAHigherRow)
{
    const LeafLayout layout = leafLayout({0, 0, 320, 80}, {100, 18}, {60, 18});
    EXPECT_EQ(layout.key, (Rect{10, 31, 100, 18}));
    EXPECT_EQ(layout.scrollView, (Rect{0, 0, 320, 50}));
    EXPECT_EQ(layout.contentSize, (Size{320, 50}));
}

} // namespace
} // namespace test
} // namespace pelorus
