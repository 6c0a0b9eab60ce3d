// What the table does with fingers.

#include "app/TableView.h"

#include <QScrollBar>
#include <QScroller>
#include <QTouchEvent>

namespace pelorus {

namespace {

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

} // namespace pelorus
