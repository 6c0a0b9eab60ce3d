#include "app/PelorusPaneController.h"

#include "app/NavigationController.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QMenu>
#include <QVBoxLayout>

namespace pelorus {

namespace {

const QString kReuseIdentifier = QStringLiteral("PelorusPaneControllerCell");

void copy(const QString& text)
{
    QGuiApplication::clipboard()->setText(text);
}

} // namespace

PelorusPaneController::PelorusPaneController(std::shared_ptr<const PelorusModelNode> node, std::string path,
                                             PaneHost& paneHost)
    : nodes(std::move(node)), keyPath(std::move(path)), host(paneHost), rows(nodes),
      table(new TableView(*this))
{
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(table);
    setFocusProxy(table);
    table->setAccessibleName(title());
    table->reloadData();
    createToolbarItems();
}

QString PelorusPaneController::title() const
{
    return nodes ? QString::fromStdString(nodes->displayName()) : QStringLiteral("Pelorus");
}

void PelorusPaneController::viewWillAppear()
{
    showTitle();
    createToolbarItems();
}

void PelorusPaneController::viewWillDisappear()
{
    table->clearFocus();
}

void PelorusPaneController::setStatus(const std::string& text, bool loading)
{
    status = text;
    isLoading = loading;
    createToolbarItems();
}

void PelorusPaneController::reloadWithNode(std::shared_ptr<const PelorusModelNode> node)
{
    nodes = std::move(node);
    rows = PaneRows(nodes);
    showTitle();
    table->reloadData();
    createToolbarItems();
}

void PelorusPaneController::createToolbarItems()
{
    items = {isLoading, status, host.allowSaveButton()};
    if (navigationController)
        navigationController->toolbarItemsChanged(*this);
}

void PelorusPaneController::showTitle()
{
    table->setAccessibleName(title());
    if (navigationController)
        navigationController->titleChanged(*this);
}

PelorusCell& PelorusPaneController::cellForRowAtIndexPath(TableView& view, int row, const QSize& size)
{
    const PelorusModelNode& child = *rows.at(row);
    const bool leaf = !child.childNodes();
    // Both kinds of row share the identifier. A leaf gets a cell that was made as one, or its value had no
    // label to be in.
    PelorusCell* cell = view.dequeueReusableCell(kReuseIdentifier, leaf);
    if (!cell)
        cell = leaf ? PelorusCell::initWithStyle(kReuseIdentifier, view.viewport())
                    : PelorusCell::initWithStyleKey(kReuseIdentifier, view.viewport());
    cell->resize(size);
    cell->setKey(QString::fromStdString(child.displayName()));
    if (leaf) {
        cell->setAccessory(PelorusCell::Accessory::none);
        cell->setValue(valueOfRow(row));
        cell->setLayout();
    } else {
        cell->setAccessory(PelorusCell::Accessory::disclosureIndicator);
        cell->setLayoutKey();
    }
    return *cell;
}

void PelorusPaneController::didSelectRowAtIndexPath(int row)
{
    const auto& child = rows.at(row);
    if (!child->childNodes()) {
        table->deselectRow();
        return;
    }
    if (!navigationController || navigationController->topViewController() != this)
        return; // a tap on a pane that slides away
    std::string childPath = keyPath;
    appendPathComponent(childPath, child->displayName());
    auto* pane = new PelorusPaneController(child, std::move(childPath), host);
    pane->setStatus(status, isLoading);
    navigationController->pushViewController(pane, true);
}

QString PelorusPaneController::nameOfRow(int row) const
{
    return QString::fromStdString(rows.at(row)->displayName());
}

QString PelorusPaneController::valueOfRow(int row) const
{
    const std::string* value = rows.at(row)->value();
    return value ? QString::fromStdString(*value) : QString();
}

void PelorusPaneController::showMenuForRow(int row, const QPoint& globalPosition)
{
    // It holds the texts as they were when it opened, and stays open while they change below it.
    auto* menu = new QMenu(this);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    const bool leaf = !rows.at(row)->childNodes();
    if (leaf)
        menu->addAction(tr("Copy Value"), [text = valueOfRow(row)] { copy(text); });
    menu->addAction(leaf ? tr("Copy Name and Value") : tr("Copy Section"),
                    [text = QString::fromStdString(rows.textOf(row))] { copy(text); });
    menu->addSeparator();
    menu->addAction(tr("Copy All"), this, [this] { copy(QString::fromStdString(rows.text())); });
    menu->popup(globalPosition);
}

void PelorusPaneController::keyPressEvent(QKeyEvent* event)
{
    if (!event->matches(QKeySequence::Copy)) {
        QWidget::keyPressEvent(event);
        return;
    }
    const auto row = table->hasHighlight() ? table->currentRow() : std::nullopt;
    if (!row)
        copy(QString::fromStdString(rows.text()));
    else if (rows.at(*row)->childNodes())
        copy(QString::fromStdString(rows.textOf(*row)));
    else
        copy(valueOfRow(*row));
}

} // namespace pelorus
