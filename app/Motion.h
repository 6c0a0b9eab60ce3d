#pragma once

#include <QPointer>
#include <QWidget>
#include <functional>

namespace pelorus {

/// How long things slide on this desktop, in milliseconds; 0 where it wants no motion.
int animationDuration(const QWidget& widget);

/// Calls `move` with 0 to 1 while the time passes, slowing down, and then `done`; at once for a duration of
/// 0. Both are dropped with the context.
void animate(QWidget& context, int duration, std::function<void(double)> move, std::function<void()> done);

} // namespace pelorus
