#include "app/TableView.h"

#include "app/Accessibility.h"
#include "app/SlimScrollBar.h"

#include <QScrollBar>
#include <QScroller>
#include <algorithm>

namespace pelorus {

namespace {

constexpr int kRowHeight = static_cast<int>(kStripHeight);

} // namespace

TableView::TableView(TableSource& shownSource, QWidget* parent)
    : QAbstractScrollArea(parent), source(shownSource)
{
    setFrameShape(QFrame::NoFrame);
    setVerticalScrollBar(new SlimScrollBar(Qt::Vertical));
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setFocusPolicy(Qt::StrongFocus);
    viewport()->setBackgroundRole(QPalette::Base);
    viewport()->setAutoFillBackground(true);
    verticalScrollBar()->setSingleStep(kRowHeight / 2);
    acceptTouch();
}

void TableView::reloadData()
{
    const std::vector<Shown> before = std::exchange(shown, {});
    const int topBefore = top();
    reusable.insert(reusable.end(), before.begin(), before.end());
    rows = source.numberOfRowsInSection();

    const auto find = [this](const std::string& identity) { return source.rowWithIdentity(identity); };
    std::erase_if(offsets, [&](const auto& offset) { return !find(offset.first); });
    if (current) {
        current = find(currentIdentity);
        highlighted = highlighted && current;
    }
    updateRange();
    const auto anchor =
        std::ranges::find_if(before, [&](const Shown& row) { return find(row.identity).has_value(); });
    if (anchor != before.end())
        verticalScrollBar()->setValue(topBefore + (*find(anchor->identity) - anchor->row) * kRowHeight);
    layOutCells();
    if (top() != topBefore)
        QScroller::scroller(viewport())->resendPrepareEvent();
    tellAccessibilityOfReload(*this);
}

PelorusCell* TableView::dequeueReusableCell(const QString& reuseIdentifier, bool leaf)
{
    auto best = reusable.end();
    for (auto each = reusable.begin(); each != reusable.end(); ++each) {
        if (each->cell->isLeaf() != leaf || each->cell->reuseIdentifier() != reuseIdentifier)
            continue;
        best = each;
        if (each->identity == rowInWork)
            break;
    }
    if (best == reusable.end())
        return nullptr;
    PelorusCell* cell = best->cell;
    reusable.erase(best);
    return cell;
}

void TableView::updateRange()
{
    QScrollBar* bar = verticalScrollBar();
    bar->setRange(0, std::max(0, rows * kRowHeight - viewport()->height()));
    bar->setPageStep(viewport()->height());
}

int TableView::top() const
{
    return verticalScrollBar()->value();
}

void TableView::layOutCells()
{
    const int first = std::min(top() / kRowHeight, rows);
    const int end = std::min((top() + viewport()->height() + kRowHeight - 1) / kRowHeight, rows);
    std::vector<Shown> kept;
    for (Shown& row : shown)
        (row.row >= first && row.row < end ? kept : reusable).push_back(std::move(row));
    shown.clear();
    auto next = kept.begin();
    for (int row = first; row < end; ++row) {
        if (next != kept.end() && next->row == row) {
            next->cell->setGeometry(rectOfRow(row));
            shown.push_back(std::move(*next++));
        } else {
            show(row);
        }
    }
    for (const Shown& unused : reusable)
        unused.cell->hide();
}

void TableView::show(int row)
{
    rowInWork = source.identityOfRow(row);
    const QRect rect = rectOfRow(row);
    PelorusCell& cell = source.cellForRowAtIndexPath(*this, row, rect.size());
    const auto offset = offsets.find(rowInWork);
    cell.setOffset(offset == offsets.end() ? 0 : offset->second);
    cell.setHighlighted(highlighted && current == row);
    cell.setGeometry(rect);
    cell.show();
    shown.push_back({&cell, row, rowInWork});
}

std::optional<int> TableView::rowAt(const QPoint& position) const
{
    const int row = (position.y() + top()) / kRowHeight;
    return position.y() + top() >= 0 && row < rows ? std::optional(row) : std::nullopt;
}

QRect TableView::rectOfRow(int row) const
{
    return {0, row * kRowHeight - top(), viewport()->width(), kRowHeight};
}

PelorusCell* TableView::cellOfRow(int row) const
{
    const auto found = std::ranges::find(shown, row, &Shown::row);
    return found == shown.end() ? nullptr : found->cell;
}

void TableView::setCurrentRow(int row)
{
    current = row;
    currentIdentity = source.identityOfRow(row);
    highlighted = true;
    for (const Shown& each : shown)
        each.cell->setHighlighted(each.row == row);
    tellAccessibilityOfFocus(*this, row);
}

void TableView::deselectRow()
{
    highlighted = false;
    for (const Shown& each : shown)
        each.cell->setHighlighted(false);
}

void TableView::scrollToRow(int row)
{
    const QRect rect = rectOfRow(row);
    if (rect.top() < 0)
        verticalScrollBar()->setValue(top() + rect.top());
    else if (rect.bottom() >= viewport()->height())
        verticalScrollBar()->setValue(top() + rect.bottom() + 1 - viewport()->height());
}

void TableView::activateRow(int row)
{
    setCurrentRow(row);
    source.didSelectRowAtIndexPath(row);
}

void TableView::openMenu(int row, const QPoint& globalPosition)
{
    setCurrentRow(row);
    source.showMenuForRow(row, globalPosition);
}

void TableView::setOffsetOfRow(int row, double offset)
{
    PelorusCell* cell = cellOfRow(row);
    if (!cell || !cell->scrollView())
        return;
    cell->setOffset(offset);
    offsets[source.identityOfRow(row)] = cell->scrollView()->offset;
}

double TableView::offsetOfRow(int row) const
{
    const auto offset = offsets.find(source.identityOfRow(row));
    return offset == offsets.end() ? 0 : offset->second;
}

void TableView::resizeEvent(QResizeEvent* event)
{
    QAbstractScrollArea::resizeEvent(event);
    updateRange();
    layOutCells();
}

void TableView::scrollContentsBy(int, int)
{
    layOutCells();
}

} // namespace pelorus
