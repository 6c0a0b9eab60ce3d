#include "app/ElidedLabel.h"

#include "app/OneLine.h"

#include <QPainter>
#include <QStyle>

namespace pelorus {

ElidedLabel::ElidedLabel(QWidget* parent) : QLabel(parent)
{
    setTextFormat(Qt::PlainText);
}

QSize ElidedLabel::minimumSizeHint() const
{
    return {0, QLabel::minimumSizeHint().height()};
}

void ElidedLabel::paintEvent(QPaintEvent*)
{
    QPainter painter(this);
    style()->drawItemText(&painter, contentsRect(), static_cast<int>(alignment()), palette(), isEnabled(),
                          fontMetrics().elidedText(onOneLine(text()), Qt::ElideRight, contentsRect().width()),
                          foregroundRole());
}

} // namespace pelorus
