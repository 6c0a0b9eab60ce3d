#include "platform/linux/LinuxTimer.h"

#include "platform/linux/CallbackBoundary.h"

#include <algorithm>
#include <limits>

namespace pelorus {

std::chrono::milliseconds timerDuration(std::chrono::nanoseconds duration)
{
    using std::chrono::milliseconds;
    return std::clamp(std::chrono::ceil<milliseconds>(duration), milliseconds(0),
                      milliseconds(std::numeric_limits<int>::max()));
}

LinuxTimer::LinuxTimer(QObject& owner, Seconds interval, std::function<void()> tick)
    : timer(new QTimer(&owner))
{
    timer->setTimerType(Qt::PreciseTimer);
    timer->callOnTimeout([tick = std::make_shared<std::function<void()>>(std::move(tick))] {
        // A copy: the tick may drop the timer, and this closure with it.
        const auto running = tick; // NOLINT(performance-unnecessary-copy-initialization)
        callAtBoundary(*running);
    });
    timer->start(timerDuration(std::chrono::round<std::chrono::nanoseconds>(interval)));
}

void LinuxTimer::invalidate()
{
    if (!timer)
        return;
    timer->stop();
    timer->deleteLater(); // not at once: this may be its own tick
    timer.clear();
}

} // namespace pelorus
