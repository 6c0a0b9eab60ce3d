#include "app/Window.h"

#include "app/Motion.h"

#include <QScreen>
#include <QSettings>

namespace pelorus {

namespace {

constexpr QSize kSmallest{320, 480};
constexpr QSize kFirst{480, 760};
const QString kGeometry = QStringLiteral("WindowGeometry");

} // namespace

Window::Window()
{
    setMinimumSize(kSmallest);
    resize(kFirst.boundedTo(screen()->availableSize())); // or the toolbar may be below the screen
}

void Window::setRootView(QWidget& view)
{
    root = &view;
    root->setParent(this);
    root->setGeometry(rect());
    root->show();
}

void Window::present(QWidget& sheet, bool animated)
{
    presented = &sheet;
    sheet.setParent(this);
    sheet.setGeometry(rect());
    sheet.setAutoFillBackground(true);
    sheet.raise();
    sheet.show();
    const auto rise = [this, &sheet](double share) {
        sheet.move(0, static_cast<int>(height() * (1 - share)));
    };
    animate(sheet, animated ? animationDuration(*this) : 0, rise, [this, &sheet] {
        if (presented == &sheet)
            root->hide(); // and its keys with it
    });
}

void Window::dismiss(QWidget& sheet, bool animated)
{
    presented = nullptr;
    root->show();
    sheet.raise();
    const auto sink = [this, &sheet](double share) { sheet.move(0, static_cast<int>(height() * share)); };
    animate(sheet, animated ? animationDuration(*this) : 0, sink, [&sheet] { sheet.deleteLater(); });
}

void Window::restorePlace()
{
    restoreGeometry(QSettings().value(kGeometry).toByteArray());
}

void Window::resizeEvent(QResizeEvent*)
{
    if (root)
        root->setGeometry(rect());
    if (presented)
        presented->setGeometry(rect());
}

void Window::closeEvent(QCloseEvent* event)
{
    QSettings().setValue(kGeometry, saveGeometry());
    QWidget::closeEvent(event);
}

} // namespace pelorus
