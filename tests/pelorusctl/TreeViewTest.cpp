#include "pelorusctl/TreeView.h"

#include "pelorusctl/Screen.h"
#include "tests/pelorusctl/Trees.h"

#include <clocale>
#include <gmock/gmock.h>

namespace pelorus {

using test::group;
using test::leaf;
using test::rows;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;

class TreeViewTest : public testing::Test {
protected:
    TreeViewTest() { std::setlocale(LC_CTYPE, "C.UTF-8"); }

    /// The number of the first row on a screen of 80 columns and 6 lines, five of the tree; 0 is the root.
    int firstRow()
    {
        const std::string line = view.lines(80, 6).at(0);
        return line == "Pelorus" ? 0 : std::stoi(line.substr(line.find("Row ") + 4));
    }
    /// The same, after these keys.
    int firstRowAfter(std::string_view keys)
    {
        firstRow(); // tells the view how large a page is
        EXPECT_TRUE(view.handleKeys(keys));
        return firstRow();
    }

    TreeView view{false};
};

TEST_F(TreeViewTest, AlignsTheValuesOfAGroup)
{
    view.setTree(
        *group("Pelorus", {group("Cell", {leaf("TAC", "7"), leaf("Identity", "12"), group("List", {})}),
                           leaf("Other", "x")}));
    view.setStatus("Updated");
    EXPECT_THAT(view.lines(30, 8),
                ElementsAre("Pelorus", "  Cell", "    TAC       7", "    Identity  12", "    List",
                            "  Other  x", "", " Updated              q: quit "));
}

TEST_F(TreeViewTest, ShowsTheStatusLineBeforeThereIsATree)
{
    view.setStatus("Connecting...");
    EXPECT_THAT(view.lines(24, 3), ElementsAre("", "", " Connecting...  q: quit "));
}

TEST_F(TreeViewTest, TellsWhereInALongTreeItIs)
{
    view.setTree(*rows(20));
    view.setStatus("S");
    EXPECT_EQ(view.lines(40, 6).at(5), " S                  1-5 of 21   q: quit ");
    view.handleKeys("G");
    EXPECT_EQ(view.lines(40, 6).at(5), " S                17-21 of 21   q: quit ");
}

TEST_F(TreeViewTest, ScrollsByLinesAndPages)
{
    view.setTree(*rows(20));
    EXPECT_EQ(firstRowAfter("j"), 1);
    EXPECT_EQ(firstRowAfter("\x1b[B\x1bOB\n"), 4);
    EXPECT_EQ(firstRowAfter("k\x1b[A\x1bOA"), 1);
    EXPECT_EQ(firstRowAfter("\x1b[6~"), 5);
    EXPECT_EQ(firstRowAfter(" "), 9);
    EXPECT_EQ(firstRowAfter("b"), 5);
    EXPECT_EQ(firstRowAfter("\x1b[5~\x1b[5~\x1b[5~"), 0);
    for (const char* end : {"G", "\x1b[F", "\x1bOF", "\x1b[4~"}) {
        EXPECT_EQ(firstRowAfter(end), 16) << end;
        EXPECT_EQ(firstRowAfter("jj\x1b[6~"), 16);
        EXPECT_EQ(firstRowAfter("k"), 15);
        for (const char* home : {"g", "\x1b[H", "\x1bOH", "\x1b[1~"}) {
            EXPECT_EQ(firstRowAfter(home), 0) << home;
            firstRowAfter("\x1b[6~");
        }
    }
}

TEST_F(TreeViewTest, QuitsOnQ)
{
    view.setTree(*rows(20));
    EXPECT_FALSE(view.handleKeys("q"));
    EXPECT_FALSE(view.handleKeys("jjqj"));
    EXPECT_TRUE(view.handleKeys(""));
    EXPECT_TRUE(view.handleKeys("xQ\x7f\r\t"));
}

TEST_F(TreeViewTest, TakesNoCommandFromInsideAnotherKey)
{
    view.setTree(*rows(40));
    EXPECT_EQ(firstRowAfter(" "), 4);
    // Shift-Down and Home of two terminals, the keypad's 1, a function key, Alt-q, Control-End, Escape twice.
    for (const char* key : {"\x1b[b", "\x1b[G", "\x1bOq", "\x1bOP", "\x1bq", "\x1b[1;5F", "\x1b[24~", "\x1b",
                            "\x1b\x1b", "\x1b[", "\x1bO", "\x1b[200"})
        EXPECT_EQ(firstRowAfter(key), 4) << (key + 1);
    EXPECT_EQ(firstRowAfter("\x1b[1;2Aj\x1bOPj"), 6);
}

TEST_F(TreeViewTest, KeepsItsPlaceWhenTheTreeShrinksAndGrows)
{
    view.setTree(*rows(20));
    EXPECT_EQ(firstRowAfter("  jj"), 10);
    view.setTree(*rows(9));
    EXPECT_EQ(firstRow(), 5);
    view.setTree(*rows(2));
    EXPECT_EQ(firstRow(), 0);
    view.setTree(*rows(30));
    EXPECT_EQ(firstRow(), 10);
}

TEST_F(TreeViewTest, ScrollsFromWhatIsShown)
{
    view.setTree(*rows(20));
    EXPECT_EQ(firstRowAfter("G"), 16);
    view.setTree(*rows(9));
    EXPECT_EQ(firstRowAfter("k"), 4);
    view.setTree(*rows(20));
    EXPECT_EQ(firstRow(), 4);
}

TEST_F(TreeViewTest, GivesTheValueTheRoomOnANarrowScreen)
{
    view.setTree(*group("Pelorus", {leaf("Serving Layer Priority", "-85.00 dBm"), leaf("A", "1")}));
    EXPECT_THAT(view.lines(24, 4), ElementsAre("Pelorus", "  Serving L…  -85.00 dBm",
                                               "  A                    1", "                q: quit "));
    // Not below a third, though.
    EXPECT_EQ(view.lines(14, 4).at(1), "  Ser…  -85.0…");
}

TEST_F(TreeViewTest, AWideTreeNeverPassesTheScreensEdge)
{
    view.setTree(
        *group("Pelorus", {group("東京のセル", {leaf("基地局の名前とその番号", "駅前の塔 12"),
                                                leaf("e\u0301\u0301", "\xFF\x1b[2J")}),
                           leaf("A name that is longer than forty-eight columns of any screen", "x")}));
    view.setStatus("Updated 2012-05-04 at 09:30:00");
    for (std::size_t columns = 0; columns <= 90; ++columns)
        for (std::size_t height = 1; height <= 9; ++height) {
            const auto lines = view.lines(columns, height);
            ASSERT_EQ(lines.size(), height);
            for (const std::string& line : lines) {
                std::size_t used = 0;
                EXPECT_EQ(fitted(line, columns, used), line) << columns << " columns";
            }
        }
}

TEST_F(TreeViewTest, ShowsTheTreeWhenThereIsOneLineOnly)
{
    view.setTree(*rows(3));
    view.setStatus("Updated");
    EXPECT_THAT(view.lines(20, 1), ElementsAre("Pelorus"));
    view.handleKeys("G");
    EXPECT_THAT(view.lines(20, 1), ElementsAre("  Row 3  3"));
}

TEST_F(TreeViewTest, NeedsNoScreenToTakeKeys)
{
    EXPECT_TRUE(view.handleKeys("jjkG g\x1b[5~\x1b[6~"));
    EXPECT_THAT(view.lines(0, 2), ElementsAre("", ""));
}

TEST_F(TreeViewTest, UsesColoursOnlyWhenTold)
{
    TreeView coloured(true);
    for (TreeView* each : {&view, &coloured}) {
        each->setTree(*group("Pelorus", {group("Cell", {leaf("TAC", "7")})}));
        each->setStatus("Updated");
    }
    EXPECT_EQ(coloured.lines(20, 4).at(1), "  \x1b[1;36mCell");
    EXPECT_EQ(coloured.lines(20, 4).at(2), "    TAC  7");
    EXPECT_EQ(coloured.lines(20, 4).at(3), "\x1b[7m Updated    q: quit ");
    for (const std::string& line : view.lines(20, 4))
        EXPECT_THAT(line, Not(HasSubstr("\x1b")));
}

TEST_F(TreeViewTest, ShowsControlCharactersAsText)
{
    view.setTree(*leaf("Pe\nlorus", "\x1b[2J"));
    EXPECT_EQ(view.lines(40, 2).at(0), "Pe\\nlorus  \\x1b[2J");
}

} // namespace pelorus
