#pragma once

#include <QColor>
#include <QIcon>
#include <QRectF>

class QPainter;

namespace pelorus {

enum class ChevronDirection { left, right };

/// An arrowhead of two strokes in the middle of the area: "there is more this way".
void paintChevron(QPainter& painter, const QRectF& area, ChevronDirection direction, const QColor& colour);

/// A colour between two, `share` of the way from the first.
QColor blend(const QColor& from, const QColor& to, double share);

} // namespace pelorus
