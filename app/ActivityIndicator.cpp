#include "app/ActivityIndicator.h"

#include "app/Motion.h"

#include <QPainter>

namespace pelorus {

namespace {

constexpr int kSpokes = 12;
constexpr int kMillisecondsAStep = 85;

} // namespace

ActivityIndicator::ActivityIndicator(QWidget* parent) : QWidget(parent)
{
    setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Fixed);
    setAccessibleName(tr("Busy"));
    setVisible(false);
}

void ActivityIndicator::setRunning(bool runs)
{
    running = runs;
    setVisible(runs);
}

void ActivityIndicator::showEvent(QShowEvent*)
{
    if (animationDuration(*this) > 0)
        timer.start(kMillisecondsAStep, this);
}

void ActivityIndicator::hideEvent(QHideEvent*)
{
    timer.stop();
}

void ActivityIndicator::timerEvent(QTimerEvent*)
{
    step = (step + 1) % kSpokes;
    update();
}

void ActivityIndicator::paintEvent(QPaintEvent*)
{
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.translate(QRectF(rect()).center());
    QColor colour = palette().color(QPalette::WindowText);
    for (int spoke = 0; spoke < kSpokes; ++spoke) {
        colour.setAlphaF(0.12F + 0.5F * static_cast<float>((spoke + kSpokes - step - 1) % kSpokes) / kSpokes);
        painter.setPen(QPen(colour, 1.8, Qt::SolidLine, Qt::RoundCap));
        painter.save();
        painter.rotate(-360.0 / kSpokes * (kSpokes - spoke));
        painter.drawLine(QPointF(0, -4.5), QPointF(0, -8.5));
        painter.restore();
    }
}

} // namespace pelorus
