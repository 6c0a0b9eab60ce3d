#include "app/CheckMarkDelegate.h"

#include "app/Chevron.h"

#include <QPainter>

namespace pelorus {

namespace {

constexpr int kRowHeight = 40;
constexpr int kMargin = 10;
constexpr int kMarkWidth = 14;

} // namespace

void CheckMarkDelegate::paint(QPainter* painter, const QStyleOptionViewItem& option,
                              const QModelIndex& index) const
{
    const QRect row = option.rect;
    const QPalette& colours = option.palette;
    const QColor base = colours.color(QPalette::Base);
    const QColor text = colours.color(QPalette::Text);
    painter->save();
    painter->setPen(text);
    painter->setFont(option.font);
    const QRect room = row.adjusted(kMargin, 0, -2 * kMargin - kMarkWidth, 0);
    painter->drawText(room, Qt::AlignLeft | Qt::AlignVCenter,
                      option.fontMetrics.elidedText(index.data().toString(), Qt::ElideRight, room.width()));
    if (index.data(Qt::CheckStateRole).toInt() == Qt::Checked) {
        painter->setRenderHint(QPainter::Antialiasing);
        painter->setPen(
            QPen(colours.color(QPalette::Highlight), 2.2, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
        const QPointF middle(row.right() - kMargin - kMarkWidth / 2.0, row.center().y() + 1);
        const QPointF points[] = {middle + QPointF(-6, 0), middle + QPointF(-2, 4.5),
                                  middle + QPointF(6, -5)};
        painter->drawPolyline(points, 3);
        painter->setRenderHint(QPainter::Antialiasing, false);
    }
    painter->fillRect(row.left() + kMargin, row.bottom(), row.width() - kMargin, 1, blend(base, text, 0.13));
    painter->restore();
}

QSize CheckMarkDelegate::sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const
{
    return {option.fontMetrics.horizontalAdvance(index.data().toString()) + 3 * kMargin + kMarkWidth,
            kRowHeight};
}

} // namespace pelorus
