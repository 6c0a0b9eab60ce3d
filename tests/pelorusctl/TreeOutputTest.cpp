#include "pelorusctl/TreeOutput.h"

#include "tests/pelorusctl/Trees.h"

#include <gtest/gtest.h>

namespace pelorus {

using test::group;
using test::leaf;
using namespace std::chrono_literals;

using Moment = std::chrono::sys_time<std::chrono::nanoseconds>;

TEST(TreeText, IndentsEachLevelByTwoBlanks)
{
    const auto tree =
        group("Pelorus", {group("Serving cell", {leaf("TAC", "7"), group("Empty", {})}), leaf("Blank", "")});
    EXPECT_EQ(treeText(*tree), "Pelorus\n  Serving cell\n    TAC: 7\n    Empty\n  Blank: \n");
}

TEST(TreeText, ShowsALoneLeaf)
{
    EXPECT_EQ(treeText(*leaf("Pelorus", "(unknown)")), "Pelorus: (unknown)\n");
}

TEST(TreeText, KeepsEachNodeOnItsLine)
{
    EXPECT_EQ(treeText(*leaf("a\nb", "c\r\nd\te")), "a\\nb: c\\x0d\\nd\\x09e\n");
}

TEST(TreeJson, TellsNamePathAndValueOrChildrenInDisplayOrder)
{
    const auto tree = group("Pelorus", {group("GSM", {leaf("B", "2"), leaf("A", "1")}), group("Cells", {})});
    EXPECT_EQ(
        treeJson(*tree, Moment(1336123800s)),
        R"({"time":1336123800.0,"tree":{"name":"Pelorus","path":"/","children":[)"
        R"({"name":"GSM","path":"/GSM","children":[{"name":"B","path":"/GSM/B","value":"2"},)"
        R"({"name":"A","path":"/GSM/A","value":"1"}]},{"name":"Cells","path":"/Cells","children":[]}]}})"
        "\n");
}

TEST(TreeJson, TellsNullWhenNoMessageCame)
{
    EXPECT_EQ(treeJson(*leaf("Pelorus", "none"), std::nullopt),
              R"({"time":null,"tree":{"name":"Pelorus","path":"/","value":"none"}})"
              "\n");
}

std::string timeIn(Moment moment)
{
    const std::string line = treeJson(*leaf("Pelorus", ""), moment);
    return line.substr(8, line.find(',') - 8);
}

TEST(TreeJson, TellsTheTimeAsPreciselyAsANumberCan)
{
    EXPECT_EQ(timeIn(Moment(1336123800250ms)), "1336123800.25");
    EXPECT_EQ(timeIn(Moment(1336123800123456us)), "1336123800.123456");
    EXPECT_EQ(timeIn(Moment(1ns)), "1e-09");
    EXPECT_EQ(timeIn(Moment(-1500ms)), "-1.5");
    EXPECT_EQ(timeIn(Moment(8'000'000'000s)), "8000000000.0");
}

TEST(TreeJson, IsOneLineWhateverTheTextsHold)
{
    EXPECT_EQ(treeJson(*leaf("a\"\\", "\n\x1b\t\xC3\xA9"), std::nullopt),
              R"({"time":null,"tree":{"name":"a\"\\","path":"/","value":"\n\u001b\t)"
              "\xC3\xA9\"}}\n");
}

TEST(TreeJson, ShowsBytesThatAreNoUtf8AsReplacementCharacters)
{
    EXPECT_EQ(treeJson(*leaf("n\xFF", "\xC3(\x80"), std::nullopt),
              "{\"time\":null,\"tree\":{\"name\":\"n\xEF\xBF\xBD\",\"path\":\"/\",\"value\":\"\xEF\xBF\xBD("
              "\xEF\xBF\xBD\"}}\n");
}

TEST(TreeJson, KeepsASlashInAName)
{
    EXPECT_EQ(
        treeJson(*group("Pelorus", {group("Ec/Io", {leaf("A", "-7")})}), std::nullopt),
        R"({"time":null,"tree":{"name":"Pelorus","path":"/","children":[{"name":"Ec/Io","path":"/Ec/Io",)"
        R"("children":[{"name":"A","path":"/Ec/Io/A","value":"-7"}]}]}})"
        "\n");
}

} // namespace pelorus
