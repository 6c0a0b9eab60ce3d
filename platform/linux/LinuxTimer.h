#pragma once

#include "platform/Platform.h"

#include <QPointer>
#include <QTimer>

namespace pelorus {

/// A repeating timer on the event loop. `tick` may destroy it.
class LinuxTimer : public RepeatingTimer {
public:
    /// Ends with `owner`, too.
    LinuxTimer(QObject& owner, Seconds interval, std::function<void()> tick);
    ~LinuxTimer() override { LinuxTimer::invalidate(); }
    void invalidate() override;

private:
    QPointer<QTimer> timer;
};

/// A duration for Qt's timers, which count whole milliseconds: never early.
std::chrono::milliseconds timerDuration(std::chrono::nanoseconds duration);

} // namespace pelorus
