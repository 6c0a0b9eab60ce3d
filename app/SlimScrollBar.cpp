#include "app/SlimScrollBar.h"

#include "app/Chevron.h"

#include <QPainter>
#include <QStyleOptionSlider>

namespace pelorus {

namespace {

constexpr int kWidth = 10;
constexpr int kThumb = 5;

} // namespace

QSize SlimScrollBar::sizeHint() const
{
    return {kWidth, QScrollBar::sizeHint().height()};
}

void SlimScrollBar::paintEvent(QPaintEvent*)
{
    QStyleOptionSlider option;
    initStyleOption(&option);
    const QRectF thumb =
        style()->subControlRect(QStyle::CC_ScrollBar, &option, QStyle::SC_ScrollBarSlider, this);
    QPainter painter(this);
    const QColor base = palette().color(QPalette::Base);
    painter.fillRect(rect(), base);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(Qt::NoPen);
    painter.setBrush(
        blend(base, palette().color(QPalette::Text), isSliderDown() || underMouse() ? 0.45 : 0.25));
    painter.drawRoundedRect(QRectF((width() - kThumb) / 2.0, thumb.y() + 1, kThumb, thumb.height() - 2),
                            kThumb / 2.0, kThumb / 2.0);
}

} // namespace pelorus
