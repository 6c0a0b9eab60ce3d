#include "app/Motion.h"

#include <QStyle>
#include <QVariantAnimation>

namespace pelorus {

int animationDuration(const QWidget& widget)
{
    return widget.style()->styleHint(QStyle::SH_Widget_Animation_Duration, nullptr, &widget);
}

void animate(QWidget& context, int duration, std::function<void(double)> move, std::function<void()> done)
{
    if (duration <= 0) {
        move(1);
        done();
        return;
    }
    move(0);
    auto* animation = new QVariantAnimation(&context);
    animation->setStartValue(0.0);
    animation->setEndValue(1.0);
    animation->setDuration(duration);
    animation->setEasingCurve(QEasingCurve::OutCubic);
    QObject::connect(animation, &QVariantAnimation::valueChanged, &context,
                     [move = std::move(move)](const QVariant& value) { move(value.toDouble()); });
    QObject::connect(animation, &QVariantAnimation::finished, &context, std::move(done));
    animation->start(QAbstractAnimation::DeleteWhenStopped);
}

} // namespace pelorus
