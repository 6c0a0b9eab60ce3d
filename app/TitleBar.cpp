#include "app/TitleBar.h"

#include "app/Bars.h"
#include "app/Chevron.h"
#include "app/ElidedLabel.h"
#include "app/OneLine.h"
#include "app/TextLabel.h"

#include <QEvent>
#include <QPainter>
#include <QToolButton>

namespace pelorus {

namespace {

constexpr int kSpace = 6;
constexpr int kArrowSize = 16;
constexpr int kShortestName = 64;

} // namespace

TitleBar::TitleBar(std::function<void()> back, QWidget* parent)
    : QWidget(parent), button(new QToolButton(this)), label(new ElidedLabel(this))
{
    setFixedHeight(kBarHeight);
    label->setFont(systemFont(kCellFontSize + 1, QFont::DemiBold));
    label->setAlignment(Qt::AlignCenter);
    button->setAutoRaise(true);
    button->setFont(systemFont(kStatusFontSize));
    button->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    button->setIconSize({kArrowSize, kArrowSize});
    button->setFocusPolicy(Qt::TabFocus);
    button->setFixedHeight(kBarHeight - 2 * kSpace);
    button->hide();
    drawArrow();
    connect(button, &QToolButton::clicked, this, std::move(back));
}

void TitleBar::setTitle(const QString& title)
{
    if (label->text() == title)
        return;
    label->setText(title);
    arrange();
}

QString TitleBar::title() const
{
    return label->text();
}

void TitleBar::setBackTitle(const std::optional<QString>& title)
{
    button->setVisible(title.has_value());
    if (backTitle == title)
        return;
    backTitle = title;
    button->setAccessibleName(title ? tr("Back to %1").arg(*title) : QString());
    button->setToolTip(asPlainToolTip(button->accessibleName()));
    arrange();
}

void TitleBar::resizeEvent(QResizeEvent*)
{
    arrange();
}

/// The title is in the middle. The way back yields first: it is only an arrow where its name would be cut
/// down to nothing.
void TitleBar::arrange()
{
    const int ofArrow = kArrowSize + 20;
    const int titleWidth = std::min(label->sizeHint().width(), width() - 2 * (ofArrow + 2 * kSpace));
    const int room = (width() - titleWidth) / 2 - 2 * kSpace;
    const QString name = onOneLine(backTitle.value_or(QString()));
    const int needed = button->fontMetrics().horizontalAdvance(name);
    const bool named = room - ofArrow >= std::min(needed, kShortestName);
    // An ampersand is part of the name, not the mark of a key.
    button->setText(button->fontMetrics()
                        .elidedText(name, Qt::ElideRight, room - ofArrow)
                        .replace(QStringLiteral("&"), QStringLiteral("&&")));
    button->setToolButtonStyle(named ? Qt::ToolButtonTextBesideIcon : Qt::ToolButtonIconOnly);
    button->resize(named ? std::min(button->sizeHint().width(), room) : ofArrow, button->height());
    button->move(kSpace, kSpace);
    const int side = button->isHidden() ? 2 * kSpace : button->geometry().right() + 1 + kSpace;
    label->setGeometry(side, 0, width() - 2 * side, height());
}

void TitleBar::paintEvent(QPaintEvent*)
{
    QPainter painter(this);
    const QPalette& colours = palette();
    painter.fillRect(0, height() - 1, width(), 1,
                     blend(colours.color(QPalette::Window), colours.color(QPalette::WindowText), 0.18));
}

void TitleBar::changeEvent(QEvent* event)
{
    if (event->type() == QEvent::PaletteChange)
        drawArrow();
    QWidget::changeEvent(event);
}

void TitleBar::drawArrow()
{
    const int scale = 4; // enough for any screen; the icon is scaled down
    QPixmap pixmap(kArrowSize * scale, kArrowSize * scale);
    pixmap.setDevicePixelRatio(scale);
    pixmap.fill(Qt::transparent);
    QPainter painter(&pixmap);
    paintChevron(painter, {0, 2, kArrowSize, kArrowSize - 4}, ChevronDirection::left,
                 palette().color(QPalette::ButtonText));
    painter.end();
    button->setIcon(pixmap);
}

} // namespace pelorus
