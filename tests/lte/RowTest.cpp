#include "LogGenerator/Osprey/Row.h"
#include "LogGenerator/Osprey/LTE/LTEServingCellInfo.h"
#include "tests/support/SectionFixture.h"

#include <gtest/gtest.h>

namespace pelorus::test {
namespace {

constexpr std::string_view kTexts[] = {"zero", "one"};
constexpr Row kRows[] = {number("Number", "%d", u8(0)), text("Text", u8(1), kTexts, "other")};
constexpr Row kOtherRows[] = {number("Number", "%d dB", u8(0))};

std::string shown(Dictionary& entry, std::span<const Row> rows, unsigned first, unsigned second)
{
    showRows(entry, rows, PacketView(PacketBuilder(2).u8(0, first).u8(1, second).bytes()));
    return textOf(std::make_shared<Dictionary>(entry));
}

TEST(Row, ShowsTheSameNumberAgainAfterItsTextWasChanged)
{
    Dictionary entry;
    EXPECT_EQ(shown(entry, kRows, 7, 1), "Number: 7\nText: one\n");
    entry.slot("Number").text() = "changed";
    entry.set("Text", "changed");
    EXPECT_EQ(shown(entry, kRows, 7, 1), "Number: 7\nText: one\n");
}

TEST(Row, ShowsTheSameNumberAgainInItsOwnFormat)
{
    Dictionary entry;
    EXPECT_EQ(shown(entry, kRows, 7, 2), "Number: 7\nText: other\n");
    EXPECT_EQ(shown(entry, kOtherRows, 7, 2), "Number: 7 dB\nText: other\n");
    EXPECT_EQ(shown(entry, kRows, 7, 0), "Number: 7\nText: zero\n");
}

TEST(Row, ShowsTheSameNumberAgainAfterTheRowWasRemoved)
{
    Dictionary entry;
    shown(entry, kRows, 7, 1);
    entry.remove("Number");
    EXPECT_EQ(shown(entry, kRows, 7, 1), "Text: one\nNumber: 7\n");
}

TEST(Row, ShowsTheSamePacketAgainAfterTheCellMonitorWroteItsRow)
{
    SectionFixture<LTEServingCellInfo> section(makeDictionary());
    const auto configuration = PacketBuilder(38).u16(14, 301);
    section.receive(0xB0C2, configuration);
    section.receive(kCellMonitorList,
                    internalPacket(makeArray({makeDictionary(
                        {{"CellMonitorCellRadioAccessTechnology", "CellMonitorRadioAccessTechnologyLTE"},
                         {"CellMonitorCellType", "CellMonitorCellTypeServing"},
                         {"CellMonitorPID", 7}})})));
    EXPECT_EQ(section.row("Physical Cell ID"), "7");
    section.receive(0xB0C2, configuration);
    EXPECT_EQ(section.row("Physical Cell ID"), "301");
}

} // namespace
} // namespace pelorus::test
