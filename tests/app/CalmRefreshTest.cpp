#include "tests/app/AppFixture.h"

#include <QClipboard>
#include <QMenu>
#include <QScrollBar>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

const std::string kLong = "a value that is so long that no window of this size shows it whole, by far";

/// Rows "Row FIRST" to "Row LAST" with long values.
Value rowsFromTo(int first, int last, const std::string& value = kLong)
{
    auto rows = makeDictionary();
    for (int row = first; row <= last; ++row)
        rows->set(fmt::format("Row {}", row), value);
    return rows;
}

class CalmRefresh : public AppFixture {
protected:
    CalmRefresh() { start(); }
    void scrollTo(int pixels) { table().verticalScrollBar()->setValue(pixels); }
    int scrolled() { return table().verticalScrollBar()->value(); }
    int rowNamed(const std::string& name)
    {
        for (int row = 0; row < table().rowCount(); ++row)
            if (table().cellOfRow(row) && table().cellOfRow(row)->key().text().toStdString() == name)
                return row;
        return -1;
    }
    double offsetOf(const std::string& name)
    {
        const PelorusCell* cell = table().cellOfRow(rowNamed(name));
        return cell ? cell->scrollView()->offset : -1;
    }
};

TEST_F(CalmRefresh, KeepsTheScrollPositionWhenValuesChange)
{
    receive(rowsFromTo(1, 100));
    scrollTo(1234);
    receive(rowsFromTo(1, 100, "another"));
    EXPECT_EQ(scrolled(), 1234);
    EXPECT_EQ(shown().front(), "Row 25: another");
}

TEST_F(CalmRefresh, KeepsTheRowInItsPlaceWhenRowsAreAddedAbove)
{
    receive(rowsFromTo(51, 100));
    scrollTo(1234); // "Row 75" is the uppermost, 34 of its 50 points are above the window
    EXPECT_EQ(shown().front(), "Row 75: " + kLong);
    receive(rowsFromTo(1, 100));
    EXPECT_EQ(scrolled(), 1234 + 50 * 50);
    EXPECT_EQ(shown().front(), "Row 75: " + kLong);
    receive(rowsFromTo(61, 100));
    EXPECT_EQ(scrolled(), 1234 - 10 * 50);
    EXPECT_EQ(shown().front(), "Row 75: " + kLong);
}

TEST_F(CalmRefresh, HoldsOnToTheNextRowWhenTheUppermostVanishes)
{
    receive(rowsFromTo(1, 100));
    scrollTo(1234);
    ASSERT_EQ(table().rectOfRow(25).top(), 16); // "Row 26"
    receive(rowsFromTo(26, 100));
    EXPECT_EQ(rowNamed("Row 26"), 0);
    EXPECT_EQ(scrolled(), 0) << "above it is nothing any more";
    auto rows = rowsFromTo(0, 20);
    for (int row = 26; row <= 100; ++row)
        rows.dictionary()->set(fmt::format("Row {}", row), kLong);
    receive(rows);
    EXPECT_EQ(table().rectOfRow(rowNamed("Row 26")).top(), 0);
}

TEST_F(CalmRefresh, EndsAtTheLastRowWhenTheRestVanishes)
{
    receive(rowsFromTo(1, 100));
    scrollTo(4000);
    receive(rowsFromTo(1, 20));
    EXPECT_EQ(scrolled(), table().verticalScrollBar()->maximum());
    EXPECT_EQ(shown().back(), "Row 20: " + kLong);
    receive(makeDictionary());
    EXPECT_EQ(table().rowCount(), 0);
}

TEST_F(CalmRefresh, KeepsEachStripsOffset)
{
    receive(rowsFromTo(1, 100));
    const auto shiftWheel = [this](int row, int notches) {
        QWheelEvent event(centre(row), table().viewport()->mapToGlobal(centre(row)), {}, {0, -120 * notches},
                          Qt::NoButton, Qt::ShiftModifier, Qt::NoScrollPhase, false);
        QApplication::sendEvent(table().viewport(), &event);
    };
    shiftWheel(0, 1);
    shiftWheel(2, 2);
    EXPECT_EQ(offsetOf("Row 1"), 60);
    EXPECT_EQ(offsetOf("Row 2"), 0);
    EXPECT_EQ(offsetOf("Row 3"), 120);
    receive(rowsFromTo(1, 100, kLong + "!"));
    EXPECT_EQ(offsetOf("Row 1"), 60);
    EXPECT_EQ(offsetOf("Row 3"), 120);
    scrollTo(3000); // their cells are others' now
    EXPECT_EQ(offsetOf("Row 61"), 0);
    receive(rowsFromTo(-4, 100));
    scrollTo(0);
    EXPECT_EQ(offsetOf("Row -4"), 0);
    EXPECT_EQ(offsetOf("Row 1"), 60);
    EXPECT_EQ(offsetOf("Row 2"), 0);
    EXPECT_EQ(offsetOf("Row 3"), 120);
    receive(rowsFromTo(1, 100, "short"));
    EXPECT_EQ(offsetOf("Row 1"), 0);
}

TEST_F(CalmRefresh, KeepsTheChosenRow)
{
    receive(rowsFromTo(11, 100));
    press(Qt::Key_Down);
    press(Qt::Key_Down);
    EXPECT_TRUE(table().cellOfRow(1)->isHighlighted()); // "Row 12"
    receive(rowsFromTo(9, 100));
    const int row = rowNamed("Row 12");
    EXPECT_EQ(row, 3);
    EXPECT_EQ(table().currentRow(), 3);
    EXPECT_TRUE(table().cellOfRow(3)->isHighlighted());
    EXPECT_FALSE(table().cellOfRow(1) && table().cellOfRow(1)->isHighlighted());
    receive(rowsFromTo(13, 100));
    EXPECT_EQ(table().currentRow(), std::nullopt);
    EXPECT_FALSE(table().cellOfRow(0)->isHighlighted());
}

TEST_F(CalmRefresh, KeepsTheCellsOfTheRowsInSight)
{
    receive(rowsFromTo(1, 100));
    const PelorusCell* first = table().cellOfRow(0);
    const PelorusCell* third = table().cellOfRow(2);
    receive(rowsFromTo(1, 100, "another"));
    EXPECT_EQ(table().cellOfRow(0), first);
    EXPECT_EQ(table().cellOfRow(2), third);
}

TEST_F(CalmRefresh, KeepsAnOpenMenu)
{
    receive(rowsFromTo(1, 10, "old"));
    table().openMenu(2, {100, 100});
    const QPointer<QMenu> menu = top().findChild<QMenu*>();
    ASSERT_TRUE(menu && menu->isVisible());
    receive(rowsFromTo(-5, 10, "new"));
    ASSERT_TRUE(menu && menu->isVisible());
    menu->actions().front()->trigger();
    EXPECT_EQ(QApplication::clipboard()->text(), "old") << "what was shown when the menu opened";
    menu->close();
}

TEST_F(CalmRefresh, HasCellsOnlyForTheRowsInSight)
{
    receive(rowsFromTo(1, 1000));
    scrollTo(20'000);
    scrollTo(3);
    scrollTo(40'000);
    receive(rowsFromTo(1, 1000, "another"));
    const int inSight = table().viewport()->height() / 50 + 2;
    EXPECT_LE(table().viewport()->findChildren<QWidget*>().size(), 2 * inSight);
    EXPECT_EQ(table().rowCount(), 1000);
    EXPECT_EQ(shown().front(), "Row 801: another");
}

TEST_F(CalmRefresh, ARowThatChangesItsKindGetsACellOfThatKind)
{
    receive(makeDictionary({{"A", "1"}, {"B", cell("7", "3")}}));
    EXPECT_THAT(shown(), ElementsAre("A: 1", "B >"));
    receive(makeDictionary({{"A", cell("7", "3")}, {"B", "2"}}));
    EXPECT_THAT(shown(), ElementsAre("A >", "B: 2"));
    EXPECT_EQ(table().cellOfRow(0)->accessory(), PelorusCell::Accessory::disclosureIndicator);
    EXPECT_EQ(table().cellOfRow(1)->accessory(), PelorusCell::Accessory::none);
}

} // namespace
} // namespace pelorus::test
