#include "tests/app/AppFixture.h"

#include <QClipboard>
#include <QMenu>
#include <QScrollBar>
#include <QScroller>
#include <QSignalSpy>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

class TableInput : public AppFixture {
protected:
    TableInput()
    {
        start();
        app.getWindow()->resize(360, 480); // 384 points for the rows
        auto rows = makeDictionary();
        rows->set("Cell", cell("7", "3"));
        for (int row = 1; row < 20; ++row)
            rows->set(fmt::format("Row {}", row), "a value that is so long that no window shows it whole");
        receive(rows);
    }
    double offset(int row) { return table().cellOfRow(row)->scrollView()->offset; }
    std::string copied() { return QApplication::clipboard()->text().toStdString(); }

    std::unique_ptr<QPointingDevice> screen{QTest::createTouchDevice()};
};

TEST_F(TableInput, ATapOnALeafOnlyDeselectsIt)
{
    click(1);
    EXPECT_EQ(depth(), 1u);
    EXPECT_FALSE(table().hasHighlight());
    EXPECT_FALSE(table().cellOfRow(1)->isHighlighted());
    EXPECT_EQ(table().currentRow(), 1) << "where the keyboard goes on";
}

TEST_F(TableInput, AnInnerNodeStaysChosenBehindItsPane)
{
    click(0);
    ASSERT_EQ(top().path(), "/Cell");
    press(Qt::Key_Backspace);
    EXPECT_TRUE(table().cellOfRow(0)->isHighlighted());
}

TEST_F(TableInput, ATapThatEndsOnAnotherRowIsNone)
{
    QTest::mousePress(table().viewport(), Qt::LeftButton, {}, centre(0));
    QTest::mouseRelease(table().viewport(), Qt::LeftButton, {}, centre(1));
    EXPECT_EQ(depth(), 1u);
}

TEST_F(TableInput, ArrowsGoThroughTheRowsAndEnterOpensThem)
{
    press(Qt::Key_Down);
    EXPECT_EQ(table().currentRow(), 0);
    press(Qt::Key_Up);
    EXPECT_EQ(table().currentRow(), 0);
    for (int times = 0; times < 8; ++times)
        press(Qt::Key_Down);
    EXPECT_EQ(table().currentRow(), 8);
    EXPECT_EQ(table().verticalScrollBar()->value(), 66) << "the row is in sight";
    press(Qt::Key_Return);
    EXPECT_EQ(depth(), 1u) << "a leaf";
    EXPECT_FALSE(table().hasHighlight());
    press(Qt::Key_PageDown);
    EXPECT_EQ(table().currentRow(), 14);
    press(Qt::Key_End);
    EXPECT_EQ(table().currentRow(), 19);
    press(Qt::Key_PageUp);
    EXPECT_EQ(table().currentRow(), 13);
    press(Qt::Key_Home);
    EXPECT_EQ(table().currentRow(), 0);
    press(Qt::Key_Enter);
    EXPECT_EQ(top().path(), "/Cell");
}

TEST_F(TableInput, LeftAndRightScrollTheStrip)
{
    press(Qt::Key_Down);
    press(Qt::Key_Down);
    press(Qt::Key_Right);
    EXPECT_EQ(offset(1), 48);
    press(Qt::Key_Right);
    press(Qt::Key_Left);
    EXPECT_EQ(offset(1), 48);
    press(Qt::Key_Left);
    press(Qt::Key_Left);
    EXPECT_EQ(offset(1), 0);
}

TEST_F(TableInput, TheMouseDragsAStrip)
{
    QTest::mousePress(table().viewport(), Qt::LeftButton, {}, {300, 75});
    QTest::mouseMove(table().viewport(), {200, 75});
    QTest::mouseRelease(table().viewport(), Qt::LeftButton, {}, {200, 75});
    EXPECT_EQ(offset(1), 100);
    EXPECT_EQ(offset(2), 0);
    EXPECT_EQ(table().currentRow(), std::nullopt);
}

TEST_F(TableInput, AFingerScrollsThePaneOrAStripButNotBoth)
{
    const auto swipe = [this](QPoint from, QPoint step) {
        QTest::touchEvent(table().viewport(), screen.get()).press(0, from, table().viewport());
        for (int moves = 1; moves <= 20; ++moves) {
            QTest::qWait(2);
            QTest::touchEvent(table().viewport(), screen.get())
                .move(0, from + step * moves, table().viewport());
        }
        QTest::qWait(150); // held still: no flick
        QTest::touchEvent(table().viewport(), screen.get()).release(0, from + step * 20, table().viewport());
        QScroller::scroller(table().viewport())->stop();
    };
    swipe({300, 75}, {-5, 0});
    EXPECT_GT(offset(1), 30);
    EXPECT_EQ(table().verticalScrollBar()->value(), 0);
    const double before = offset(1);
    swipe({100, 170}, {0, -5});
    EXPECT_GT(table().verticalScrollBar()->value(), 30);
    EXPECT_EQ(table().currentRow(), std::nullopt) << "a swipe is no tap";
    table().verticalScrollBar()->setValue(0);
    EXPECT_EQ(offset(1), before);
}

TEST_F(TableInput, AFingerTapsARow)
{
    QWidget* viewport = table().viewport();
    const QPoint where = centre(0);
    QTest::touchEvent(viewport, screen.get()).press(0, where, viewport);
    QTest::touchEvent(viewport, screen.get()).release(0, where, viewport);
    EXPECT_EQ(top().path(), "/Cell");
    EXPECT_EQ(depth(), 2u) << "once";
}

TEST_F(TableInput, AFingerThatIsHeldStillOpensTheMenu)
{
    QTest::touchEvent(table().viewport(), screen.get()).press(0, centre(2), table().viewport());
    ASSERT_TRUE(QTest::qWaitFor([this] { return table().hasHighlight(); }, 3000));
    EXPECT_EQ(table().currentRow(), 2);
    QTest::touchEvent(table().viewport(), screen.get()).release(0, centre(2), table().viewport());
    const QPointer<QMenu> menu = top().findChild<QMenu*>();
    ASSERT_TRUE(menu && menu->isVisible());
    QTest::qWait(50);
    ASSERT_TRUE(menu && menu->isVisible());
    menu->close();
}

TEST_F(TableInput, CopiesTheChosenRowsValueOrTheWholePane)
{
    press(Qt::Key_Down);
    press(Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(copied(), "Cell\n  Cell ID: 7\n  Band: 3");
    press(Qt::Key_Return);
    press(Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(copied(), "Cell ID: 7\nBand: 3\n");
    press(Qt::Key_Down);
    press(Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(copied(), "7");
}

TEST_F(TableInput, TheMenuCopies)
{
    click(0);
    QContextMenuEvent event(QContextMenuEvent::Mouse, centre(1), table().viewport()->mapToGlobal(centre(1)));
    QApplication::sendEvent(table().viewport(), &event);
    auto* menu = top().findChild<QMenu*>();
    ASSERT_NE(menu, nullptr);
    std::vector<std::string> texts;
    for (QAction* action : menu->actions())
        if (!action->isSeparator()) {
            action->trigger();
            texts.push_back(action->text().toStdString() + " = " + copied());
        }
    EXPECT_THAT(texts, ElementsAre("Copy Value = 3", "Copy Name and Value = Band: 3",
                                   "Copy All = Cell ID: 7\nBand: 3\n"));
    menu->close();
}

TEST_F(TableInput, TheMouseGoesBackToo)
{
    click(0);
    QTest::mouseClick(table().viewport(), Qt::BackButton, {}, centre(0));
    EXPECT_EQ(top().path(), "/");
}

} // namespace
} // namespace pelorus::test
