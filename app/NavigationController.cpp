#include "app/NavigationController.h"

#include "app/Motion.h"
#include "app/PelorusPaneController.h"
#include "app/TitleBar.h"
#include "app/Toolbar.h"

#include <QMouseEvent>
#include <QShortcut>
#include <QVBoxLayout>

namespace pelorus {

NavigationController::NavigationController(PelorusPaneController* root, QWidget* parent)
    : QWidget(parent), title(new TitleBar([this] { popViewController(true); })), room(new QWidget),
      tools(new Toolbar([this] { topViewController()->savePressed(); }))
{
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);
    layout->addWidget(title);
    layout->addWidget(room, 1);
    layout->addWidget(tools);
    room->installEventFilter(this);
    setAutoFillBackground(true);

    const auto onKeys = [this](const QKeySequence& keys, auto action) {
        auto* shortcut = new QShortcut(keys, this);
        connect(shortcut, &QShortcut::activated, this, action);
    };
    onKeys(Qt::Key_Backspace, [this] { popViewController(true); });
    onKeys(Qt::Key_Back, [this] { popViewController(true); });
    onKeys(Qt::ALT | Qt::Key_Left, [this] { popViewController(true); });
    onKeys(QKeySequence::Save, [this] {
        if (topViewController()->toolbarItems().offersSave)
            topViewController()->savePressed();
    });

    stack.push_back(root);
    adopt(*root);
}

void NavigationController::adopt(PelorusPaneController& pane)
{
    pane.setParent(room);
    pane.setNavigationController(this);
    pane.setGeometry(room->rect());
}

void NavigationController::showEvent(QShowEvent* event)
{
    QWidget::showEvent(event);
    if (std::exchange(appeared, true))
        return;
    willShow(*topViewController(), false);
    topViewController()->setFocus(Qt::OtherFocusReason);
}

void NavigationController::willShow(PelorusPaneController& pane, bool animated)
{
    pane.viewWillAppear();
    if (delegate)
        delegate->willShowViewController(pane, animated);
    showBars();
}

void NavigationController::pushViewController(PelorusPaneController* pane, bool animated)
{
    PelorusPaneController* below = topViewController();
    stack.push_back(pane);
    adopt(*pane);
    below->viewWillDisappear();
    willShow(*pane, animated);
    slide(below, pane, Way::in, animated);
}

void NavigationController::popViewController(bool animated)
{
    if (stack.size() > 1)
        popToViewController(stack.size() - 2, animated);
}

void NavigationController::popToViewController(std::size_t index, bool animated)
{
    if (index + 1 >= stack.size())
        return;
    PelorusPaneController* leaving = topViewController();
    leaving->viewWillDisappear();
    while (stack.size() > index + 1) {
        stack.back()->setNavigationController(nullptr);
        if (stack.back() != leaving)
            stack.back()->deleteLater();
        stack.pop_back();
    }
    willShow(*topViewController(), animated);
    slide(leaving, topViewController(), Way::out, animated);
}

void NavigationController::slide(PelorusPaneController* from, PelorusPaneController* to, Way way,
                                 bool animated)
{
    to->setGeometry(room->rect());
    to->show();
    (way == Way::in ? to : from)->raise();
    // A pane that goes away by itself takes the keys from nobody who types somewhere else.
    const QWidget* focus = window()->focusWidget();
    if (isVisible() && (!focus || isAncestorOf(focus)))
        to->setFocus(Qt::OtherFocusReason);
    ++slides;
    const auto move = [this, from = QPointer(from), to = QPointer(to), way](double share) {
        // The one above goes all the way, the one below a third of it.
        const int width = room->width();
        const auto place = [](QWidget* pane, double x) {
            if (pane)
                pane->move(static_cast<int>(std::lround(x)), 0);
        };
        if (way == Way::in) {
            place(to, width * (1 - share));
            place(from, -width / 3.0 * share);
        } else {
            place(to, -width / 3.0 * (1 - share));
            place(from, width * share);
        }
    };
    const auto done = [this, from = QPointer(from), way] {
        if (from && way == Way::out)
            from->deleteLater();
        if (--slides == 0)
            fillRoom();
    };
    animate(*this, animated && isVisible() ? animationDuration(*this) : 0, move, done);
}

/// Every pane of the stack where it belongs, the top one alone in sight.
void NavigationController::fillRoom()
{
    for (PelorusPaneController* pane : stack) {
        pane->setGeometry(room->rect());
        pane->setVisible(pane == topViewController());
    }
}

bool NavigationController::eventFilter(QObject* watched, QEvent* event)
{
    if (watched == room && event->type() == QEvent::Resize && slides == 0)
        fillRoom();
    return QWidget::eventFilter(watched, event);
}

void NavigationController::mousePressEvent(QMouseEvent* event)
{
    if (event->button() == Qt::BackButton)
        popViewController(true);
}

void NavigationController::showBars()
{
    title->setTitle(topViewController()->title());
    title->setBackTitle(stack.size() > 1 ? std::optional(stack[stack.size() - 2]->title()) : std::nullopt);
    tools->setItems(topViewController()->toolbarItems());
    window()->setWindowTitle(topViewController()->title());
}

void NavigationController::titleChanged(const PelorusPaneController& pane)
{
    if (&pane == topViewController())
        showBars();
}

void NavigationController::toolbarItemsChanged(const PelorusPaneController& pane)
{
    if (&pane == topViewController())
        showBars();
}

} // namespace pelorus
