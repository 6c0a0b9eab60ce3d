// What the table does with the keyboard, the mouse, the wheel and fingers.

#include "app/TableView.h"

#include <QApplication>
#include <QContextMenuEvent>
#include <QKeyEvent>
#include <QScrollBar>
#include <QScroller>
#include <algorithm>

namespace pelorus {

namespace {

constexpr double kStripStep = 48; // of a key press
constexpr int kHoldMilliseconds = 600;

} // namespace

void TableView::acceptTouch()
{
    viewport()->setAttribute(Qt::WA_AcceptTouchEvents);
    QScroller* scroller = QScroller::scroller(viewport());
    QScrollerProperties properties = scroller->scrollerProperties();
    properties.setScrollMetric(QScrollerProperties::AxisLockThreshold,
                               1.0); // the pane or one strip, never both
    properties.setScrollMetric(QScrollerProperties::HorizontalOvershootPolicy,
                               QScrollerProperties::OvershootAlwaysOff);
    properties.setScrollMetric(QScrollerProperties::VerticalOvershootPolicy,
                               QScrollerProperties::OvershootAlwaysOff);
    scroller->setScrollerProperties(properties);
}

bool TableView::viewportEvent(QEvent* event)
{
    switch (event->type()) {
    case QEvent::ScrollPrepare:
        prepareFlick(static_cast<QScrollPrepareEvent&>(*event));
        return true;
    case QEvent::Scroll:
        flick(static_cast<QScrollEvent&>(*event).contentPos());
        return true;
    case QEvent::TouchBegin:
    case QEvent::TouchUpdate:
    case QEvent::TouchEnd:
    case QEvent::TouchCancel:
        touch(static_cast<QTouchEvent&>(*event));
        return true;
    default:
        return QAbstractScrollArea::viewportEvent(event);
    }
}

/// A finger taps, flicks, or is held still for the menu, which opens when it is lifted: an open one would
/// take that for its own end.
void TableView::touch(QTouchEvent& event)
{
    event.accept();
    QScroller* scroller = QScroller::scroller(viewport());
    if (event.type() == QEvent::TouchCancel) {
        forgetPress();
        scroller->stop();
        return;
    }
    const QPointF where = event.points().front().position();
    const auto row = rowAt(where.toPoint());
    const auto time = static_cast<qint64>(event.timestamp());
    switch (event.type()) {
    case QEvent::TouchBegin:
        if (row && scroller->state() == QScroller::Inactive) { // else it only stops what moves
            press = Press{source.identityOfRow(*row), where.toPoint()};
            holdTimer.start(kHoldMilliseconds, this);
        }
        scroller->handleInput(QScroller::InputPress, where, time);
        break;
    case QEvent::TouchUpdate:
        scroller->handleInput(QScroller::InputMove, where, time);
        if (scroller->state() == QScroller::Dragging)
            forgetPress();
        break;
    default: {
        scroller->handleInput(QScroller::InputRelease, where, time);
        const auto released = press;
        forgetPress();
        if (!released || !row || source.identityOfRow(*row) != released->identity)
            break;
        if (released->held)
            openMenu(*row, viewport()->mapToGlobal(released->where));
        else
            activateRow(*row);
    }
    }
}

void TableView::forgetPress()
{
    press.reset();
    holdTimer.stop();
}

void TableView::timerEvent(QTimerEvent* event)
{
    if (event->timerId() != holdTimer.timerId()) {
        QAbstractScrollArea::timerEvent(event);
        return;
    }
    holdTimer.stop();
    const auto row = press ? source.rowWithIdentity(press->identity) : std::nullopt;
    if (!row)
        return;
    press->held = true;
    setCurrentRow(*row); // the finger may be lifted
}

void TableView::prepareFlick(QScrollPrepareEvent& event)
{
    const auto state = QScroller::scroller(viewport())->state();
    if (state == QScroller::Inactive || state == QScroller::Pressed) {
        const auto row = rowAt(event.startPos().toPoint());
        flicked = row ? source.identityOfRow(*row) : std::string();
    }
    const auto row = source.rowWithIdentity(flicked);
    const PelorusCell* cell = row ? cellOfRow(*row) : nullptr;
    event.setViewportSize(viewport()->size());
    event.setContentPosRange(
        {0, 0, cell ? cell->maximumOffset() : 0, static_cast<double>(verticalScrollBar()->maximum())});
    event.setContentPos({row ? offsetOfRow(*row) : 0, static_cast<double>(top())});
    event.accept();
}

void TableView::flick(const QPointF& position)
{
    verticalScrollBar()->setValue(static_cast<int>(std::lround(position.y())));
    if (const auto row = source.rowWithIdentity(flicked))
        setOffsetOfRow(*row, position.x());
}

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
