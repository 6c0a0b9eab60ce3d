#include "app/Chevron.h"

#include <QPainter>

namespace pelorus {

void paintChevron(QPainter& painter, const QRectF& area, ChevronDirection direction, const QColor& colour)
{
    const double half = area.height() / 2;
    const double depth = direction == ChevronDirection::right ? half / 2 : -half / 2;
    const QPointF middle = area.center();
    const QPointF points[] = {middle + QPointF(-depth, -half), middle + QPointF(depth, 0),
                              middle + QPointF(-depth, half)};
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QPen(colour, 2, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    painter.drawPolyline(points, 3);
    painter.restore();
}

QColor blend(const QColor& from, const QColor& to, double share)
{
    const auto mix = [share](float a, float b) { return a + (b - a) * static_cast<float>(share); };
    return QColor::fromRgbF(mix(from.redF(), to.redF()), mix(from.greenF(), to.greenF()),
                            mix(from.blueF(), to.blueF()));
}

} // namespace pelorus
