#include "tests/app/AppFixture.h"

#include <QAccessible>

namespace pelorus::test {
namespace {

class Accessibility : public AppFixture {
protected:
    Accessibility()
    {
        start();
        auto rows = makeDictionary({{"Cell", cell("7", "3")}, {"State", "Idle"}});
        for (int row = 2; row < 100; ++row)
            rows->set(fmt::format("Row {}", row), fmt::format("{} dBm", row));
        receive(rows);
    }
    QAccessibleInterface* list() { return QAccessible::queryAccessibleInterface(&table()); }
};

TEST_F(Accessibility, EveryRowHasItsNameAndItsValueInSightOrNot)
{
    ASSERT_NE(list(), nullptr);
    EXPECT_EQ(list()->role(), QAccessible::List);
    EXPECT_EQ(list()->text(QAccessible::Name), "Pelorus");
    ASSERT_EQ(list()->childCount(), 100);
    QAccessibleInterface* cellRow = list()->child(0);
    EXPECT_EQ(cellRow->role(), QAccessible::ListItem);
    EXPECT_EQ(cellRow->text(QAccessible::Name), "Cell");
    EXPECT_EQ(cellRow->text(QAccessible::Value), "");
    EXPECT_EQ(list()->child(1)->text(QAccessible::Name), "State");
    EXPECT_EQ(list()->child(1)->text(QAccessible::Value), "Idle");
    EXPECT_FALSE(list()->child(1)->state().offscreen);
    EXPECT_EQ(list()->child(99)->text(QAccessible::Name), "Row 99");
    EXPECT_EQ(list()->child(99)->text(QAccessible::Value), "99 dBm");
    EXPECT_TRUE(list()->child(99)->state().offscreen);
    EXPECT_EQ(list()->child(100), nullptr);
    EXPECT_EQ(list()->child(-1), nullptr);
    EXPECT_EQ(list()->indexOfChild(list()->child(42)), 42);
}

TEST_F(Accessibility, ARowIsFoundWhereItIs)
{
    const QPoint where = table().viewport()->mapToGlobal(centre(1));
    ASSERT_NE(list()->childAt(where.x(), where.y()), nullptr);
    EXPECT_EQ(list()->childAt(where.x(), where.y())->text(QAccessible::Name), "State");
    EXPECT_EQ(list()->child(1)->rect().center(), where);
    EXPECT_EQ(list()->childAt(-5, -5), nullptr);
}

TEST_F(Accessibility, ARowCanBePressed)
{
    auto* action = list()->child(0)->actionInterface();
    ASSERT_NE(action, nullptr);
    action->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_EQ(top().path(), "/Cell");
}

TEST_F(Accessibility, RowsFollowTheReload)
{
    QAccessibleInterface* last = list()->child(99);
    press(Qt::Key_Down);
    EXPECT_TRUE(list()->child(0)->state().selected);
    receive(makeDictionary({{"State", "Camped"}, {"A", "1"}}));
    EXPECT_EQ(list()->childCount(), 2);
    EXPECT_EQ(list()->child(0)->text(QAccessible::Value), "Camped");
    EXPECT_FALSE(list()->child(0)->state().selected);
    EXPECT_FALSE(last->isValid());
    EXPECT_EQ(last->text(QAccessible::Name), "");
    EXPECT_TRUE(last->state().invalid);
}

} // namespace
} // namespace pelorus::test
