#include "app/TextLabel.h"

#include "app/OneLine.h"

#include <QFontMetricsF>
#include <QGuiApplication>

namespace pelorus {

bool TextLabel::setText(const QString& text)
{
    if (string == text)
        return false;
    string = text;
    line = onOneLine(text);
    const QSizeF size = QFontMetricsF(labelFont).size(Qt::TextSingleLine, line);
    extent = {size.width(), size.height()};
    return true;
}

void TextLabel::paint(QPainter& painter) const
{
    painter.setFont(labelFont);
    painter.drawText(frame, Qt::TextSingleLine | Qt::TextDontClip | Qt::AlignLeft | Qt::AlignVCenter, line);
}

QFont systemFont(int size, QFont::Weight weight)
{
    QFont font = QGuiApplication::font();
    font.setPixelSize(
        size); // Qt's pixels are device-independent; its points would grow apart from the margins
    font.setWeight(weight);
    return font;
}

} // namespace pelorus
