#include "app/Accessibility.h"

#include "app/ActivityIndicator.h"
#include "app/TableView.h"

#include <QAccessibleWidget>
#include <QPointer>

namespace pelorus {

namespace {

class RowInterface : public QAccessibleInterface, public QAccessibleActionInterface {
public:
    RowInterface(TableView& shownTable, int shownRow) : table(&shownTable), row(shownRow) {}

    bool isValid() const override { return table && row < table->rowCount(); }
    QObject* object() const override { return nullptr; }
    QAccessibleInterface* parent() const override { return QAccessible::queryAccessibleInterface(table); }
    QAccessibleInterface* child(int) const override { return nullptr; }
    QAccessibleInterface* childAt(int, int) const override { return nullptr; }
    int childCount() const override { return 0; }
    int indexOfChild(const QAccessibleInterface*) const override { return -1; }
    QAccessible::Role role() const override { return QAccessible::ListItem; }
    int index() const { return row; }

    QString text(QAccessible::Text what) const override
    {
        if (!isValid())
            return {};
        switch (what) {
        case QAccessible::Name:
            return table->tableSource().nameOfRow(row);
        case QAccessible::Value: // not every screen reader is told of this one
        case QAccessible::Description:
            return table->tableSource().valueOfRow(row);
        default:
            return {};
        }
    }
    void setText(QAccessible::Text, const QString&) override {}

    QRect rect() const override
    {
        if (!isValid())
            return {};
        const QRect inViewport = table->rectOfRow(row);
        return {table->viewport()->mapToGlobal(inViewport.topLeft()), inViewport.size()};
    }
    QAccessible::State state() const override
    {
        QAccessible::State state;
        state.invalid = !isValid();
        if (state.invalid)
            return state;
        state.focusable = true;
        state.selectable = true;
        const bool current = table->currentRow() == row;
        state.focused = current && table->hasFocus();
        state.selected = current && table->hasHighlight();
        state.offscreen = !table->viewport()->rect().intersects(table->rectOfRow(row));
        return state;
    }

    void* interface_cast(QAccessible::InterfaceType type) override
    {
        return type == QAccessible::ActionInterface ? static_cast<QAccessibleActionInterface*>(this)
                                                    : nullptr;
    }
    QStringList actionNames() const override { return {pressAction()}; }
    void doAction(const QString& name) override
    {
        if (name == pressAction() && isValid()) {
            table->scrollToRow(row);
            table->activateRow(row);
        }
    }
    QStringList keyBindingsForAction(const QString&) const override { return {}; }

private:
    QPointer<TableView> table;
    int row;
};

class TableInterface : public QAccessibleWidget {
public:
    explicit TableInterface(TableView& shownTable)
        : QAccessibleWidget(&shownTable, QAccessible::List), table(shownTable)
    {}
    ~TableInterface() override
    {
        for (const QAccessible::Id id : rows)
            QAccessible::deleteAccessibleInterface(id);
    }

    int childCount() const override { return table.rowCount(); }
    QAccessibleInterface* child(int row) const override
    {
        if (row < 0 || row >= table.rowCount())
            return nullptr;
        while (static_cast<int>(rows.size()) <= row)
            rows.push_back(QAccessible::registerAccessibleInterface(
                new RowInterface(table, static_cast<int>(rows.size()))));
        return QAccessible::accessibleInterface(rows[static_cast<std::size_t>(row)]);
    }
    QAccessibleInterface* childAt(int x, int y) const override
    {
        const QPoint position = table.viewport()->mapFromGlobal(QPoint(x, y));
        const auto row = table.viewport()->rect().contains(position) ? table.rowAt(position) : std::nullopt;
        return row ? child(*row) : nullptr;
    }
    int indexOfChild(const QAccessibleInterface* interface) const override
    {
        const auto* row = dynamic_cast<const RowInterface*>(interface);
        return row ? row->index() : -1;
    }
    QAccessibleInterface* focusChild() const override
    {
        return table.hasFocus() && table.currentRow() ? child(*table.currentRow()) : nullptr;
    }

private:
    TableView& table;
    mutable std::vector<QAccessible::Id> rows; // made when somebody asks
};

QAccessibleInterface* makeInterface(const QString&, QObject* object)
{
    if (auto* table = dynamic_cast<TableView*>(object))
        return new TableInterface(*table);
    if (auto* indicator = dynamic_cast<ActivityIndicator*>(object))
        return new QAccessibleWidget(indicator, QAccessible::Animation);
    return nullptr;
}

} // namespace

void installAccessibility()
{
    QAccessible::installFactory(makeInterface);
}

void tellAccessibilityOfReload(TableView& table)
{
    if (!QAccessible::isActive())
        return;
    QAccessibleEvent event(&table, QAccessible::ObjectReorder);
    QAccessible::updateAccessibility(&event);
}

void tellAccessibilityOfFocus(TableView& table, int row)
{
    if (!QAccessible::isActive() || !table.hasFocus())
        return;
    QAccessibleEvent event(&table, QAccessible::Focus);
    event.setChild(row);
    QAccessible::updateAccessibility(&event);
}

} // namespace pelorus
