#include "telephonyd/modem/CallSchedule.h"

#include <algorithm>

namespace pelorus {

void CallSchedule::succeeded(Time now)
{
    inFlight = false;
    pause = {};
    next = now + interval;
}

void CallSchedule::failed(Time now)
{
    inFlight = false;
    pause = std::min(std::max(pause, interval) * 2, std::max(kLongestPause, interval));
    next = now + pause;
}

void CallSchedule::isImpossible()
{
    inFlight = false;
    impossible = true;
}

void CallSchedule::retryAt(Time now)
{
    if (pause.count() == 0)
        return;
    pause = {};
    next = now;
}

} // namespace pelorus
