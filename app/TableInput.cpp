// What the table does with the keyboard, the mouse and the wheel.

#include "app/TableView.h"

#include <QApplication>
#include <QContextMenuEvent>
#include <QKeyEvent>
#include <QScrollBar>
#include <algorithm>

namespace pelorus {

namespace {

constexpr double kStripStep = 48; // of a key press

} // namespace

void TableView::mousePressEvent(QMouseEvent* event)
{
    press.reset();
    const auto row = rowAt(event->pos());
    if (event->button() != Qt::LeftButton)
        event->ignore(); // for who holds the table
    else if (row)
        press = Press{source.identityOfRow(*row), event->pos(), offsetOfRow(*row)};
}

void TableView::mouseMoveEvent(QMouseEvent* event)
{
    const auto row = press ? source.rowWithIdentity(press->identity) : std::nullopt;
    if (!row)
        return;
    const QPoint way = event->pos() - press->where;
    if (way.manhattanLength() >= QApplication::startDragDistance())
        press->drags = true;
    if (press->drags)
        setOffsetOfRow(*row, press->offset - way.x());
}

void TableView::mouseReleaseEvent(QMouseEvent* event)
{
    const auto released = std::exchange(press, std::nullopt);
    const auto row = rowAt(event->pos());
    if (released && !released->drags && row && source.identityOfRow(*row) == released->identity)
        activateRow(*row);
}

void TableView::contextMenuEvent(QContextMenuEvent* event)
{
    if (event->reason() == QContextMenuEvent::Mouse) {
        if (const auto row = rowAt(event->pos()))
            openMenu(*row, event->globalPos());
    } else if (current) {
        scrollToRow(*current);
        openMenu(*current, viewport()->mapToGlobal(rectOfRow(*current).center()));
    }
}

void TableView::wheelEvent(QWheelEvent* event)
{
    const QPoint way = event->pixelDelta().isNull() ? event->angleDelta() / 2 : event->pixelDelta();
    const bool sideways = event->modifiers() & Qt::ShiftModifier || std::abs(way.x()) > std::abs(way.y());
    if (!sideways) {
        QAbstractScrollArea::wheelEvent(event);
        return;
    }
    if (const auto row = rowAt(event->position().toPoint()))
        setOffsetOfRow(*row, offsetOfRow(*row) - (way.x() != 0 ? way.x() : way.y()));
    event->accept();
}

void TableView::moveCurrent(int row)
{
    if (rows == 0)
        return;
    setCurrentRow(std::clamp(row, 0, rows - 1));
    scrollToRow(*current);
}

void TableView::keyPressEvent(QKeyEvent* event)
{
    const int rowHeight = static_cast<int>(kStripHeight);
    const int firstInSight = (top() + rowHeight - 1) / rowHeight;
    const int page = std::max(1, viewport()->height() / rowHeight - 1);
    const auto from = [&](int distance) { return current ? *current + distance : firstInSight; };
    switch (event->modifiers() & Qt::AltModifier ? 0 : event->key()) {
    case Qt::Key_Down:
        return moveCurrent(from(1));
    case Qt::Key_Up:
        return moveCurrent(from(-1));
    case Qt::Key_PageDown:
        return moveCurrent(from(page));
    case Qt::Key_PageUp:
        return moveCurrent(from(-page));
    case Qt::Key_Home:
        return moveCurrent(0);
    case Qt::Key_End:
        return moveCurrent(rows - 1);
    case Qt::Key_Left:
    case Qt::Key_Right:
        if (current)
            setOffsetOfRow(*current,
                           offsetOfRow(*current) + (event->key() == Qt::Key_Left ? -1 : 1) * kStripStep);
        return;
    case Qt::Key_Return:
    case Qt::Key_Enter:
    case Qt::Key_Space:
        if (current && !event->isAutoRepeat())
            activateRow(*current);
        return;
    default:
        event->ignore(); // for who holds the table
    }
}

void TableView::focusInEvent(QFocusEvent* event)
{
    const bool byKeyboard =
        event->reason() == Qt::TabFocusReason || event->reason() == Qt::BacktabFocusReason;
    if (byKeyboard && rows > 0)
        setCurrentRow(current.value_or(*rowAt({0, 0})));
    QAbstractScrollArea::focusInEvent(event);
}

} // namespace pelorus
