#include "app/Toolbar.h"

#include "app/ActivityIndicator.h"
#include "app/Bars.h"
#include "app/Chevron.h"
#include "app/ElidedLabel.h"
#include "app/TextLabel.h"

#include <QHBoxLayout>
#include <QPainter>
#include <QToolButton>

namespace pelorus {

namespace {

constexpr int kMargin = 10;

} // namespace

Toolbar::Toolbar(std::function<void()> save, QWidget* parent)
    : QWidget(parent), wheel(new ActivityIndicator), label(new ElidedLabel), button(new QToolButton)
{
    setFixedHeight(kBarHeight);
    label->setFont(systemFont(kStatusFontSize));
    button->setFont(systemFont(kStatusFontSize));
    button->setText(tr("Save"));
    button->setToolTip(tr("Save a snapshot (Ctrl+S)"));
    button->setFocusPolicy(Qt::TabFocus);
    button->setMinimumHeight(32);
    connect(button, &QToolButton::clicked, this, std::move(save));

    auto* layout = new QHBoxLayout(this);
    layout->setContentsMargins(kMargin, 1, kMargin, 0);
    layout->addWidget(wheel);
    layout->addWidget(label);
    layout->addStretch(1);
    layout->addWidget(button);
}

void Toolbar::setItems(const ToolbarItems& items)
{
    wheel->setRunning(items.indicatorRuns);
    button->setVisible(items.offersSave);
    status = QString::fromStdString(items.status);
    showText();
}

void Toolbar::setNotice(const QString& text)
{
    notice = text;
    showText();
}

void Toolbar::showText()
{
    QString text = status;
    if (!notice.isEmpty())
        text = wheel->isRunning() ? status + QStringLiteral("  ") + notice : notice;
    if (label->text() == text)
        return;
    label->setText(text);
    label->setToolTip(text);
}

void Toolbar::paintEvent(QPaintEvent*)
{
    QPainter painter(this);
    const QPalette& colours = palette();
    painter.fillRect(0, 0, width(), 1,
                     blend(colours.color(QPalette::Window), colours.color(QPalette::WindowText), 0.18));
}

} // namespace pelorus
