#pragma once

#include "app/content/CellLayout.h"

#include <QFont>
#include <QPainter>
#include <QString>

namespace pelorus {

/// One line of text in a font at a place. It is painted by whoever holds it.
class TextLabel {
public:
    explicit TextLabel(const QFont& labelFont) : labelFont(labelFont) {}

    const QFont& font() const { return labelFont; }
    const QString& text() const { return string; }
    /// False when the text is that already.
    bool setText(const QString& text);
    /// The text's extent; it is measured once.
    Size size() const { return extent; }
    void paint(QPainter& painter) const;

    QRectF frame;

private:
    QFont labelFont;
    QString string;
    QString line; // what is painted
    Size extent;
};

/// The system's font in that size, in points.
QFont systemFont(int size, QFont::Weight weight = QFont::Normal);

} // namespace pelorus
