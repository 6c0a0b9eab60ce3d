#include "telephonyd/server/Pace.h"

#include <algorithm>

namespace pelorus {

namespace {

using namespace std::chrono_literals;

constexpr Pace::Time kEmptyRound = 1s;
/// Longer than any stream, and far enough from the end of the range to add to.
constexpr Pace::Time kNever = std::chrono::hours(24) * 365 * 100;

Pace::Time scaled(Pace::Time gap, double speed)
{
    const double nanoseconds = static_cast<double>(gap.count()) / speed;
    return nanoseconds < static_cast<double>(kNever.count())
               ? Pace::Time(static_cast<std::int64_t>(nanoseconds))
               : kNever;
}

} // namespace

Pace Pace::ownTiming(double speed)
{
    Pace pace;
    pace.speed = speed;
    return pace;
}

Pace Pace::rate(double messagesPerSecond)
{
    Pace pace;
    pace.interval = 1e9 / messagesPerSecond;
    return pace;
}

void Pace::advance(Time time)
{
    // The difference of two times far apart may not be a time.
    if (last && time > *last && speed > 0 && *last > time - kNever)
        position = std::min(position + scaled(time - *last, speed), kNever);
    last = time;
}

Pace::Time Pace::due() const
{
    if (interval > 0)
        return Time(static_cast<std::int64_t>(std::min(static_cast<double>(count) * interval, 3e18)));
    return position;
}

void Pace::startOver()
{
    if (speed > 0 && position == roundBegan)
        position += kEmptyRound;
    roundBegan = position;
    last.reset();
}

} // namespace pelorus
