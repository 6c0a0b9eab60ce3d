#include "pelorusctl/OfflineMonitor.h"

namespace pelorus {

OfflineMonitor::OfflineMonitor(std::unique_ptr<LogGenerator> technology,
                               std::optional<std::chrono::nanoseconds> every, Refreshed callback)
    : generator(std::move(technology)), interval(every), refreshed(std::move(callback))
{}

void OfflineMonitor::receive(const RecordedMessage& message)
{
    if (interval && !nextTick)
        nextTick = message.time + *interval;
    if (nextTick && message.time > *nextTick) {
        if (updated)
            refresh();
        nextTick = tickFrom(*nextTick, message.time);
    }
    generator->updateState(state, message.bytes);
    lastMessage = message.time;
    updated = true;
}

RecordedTime OfflineMonitor::tickFrom(RecordedTime passed, RecordedTime moment) const
{
    // Unsigned, because recorded times can lie further apart than a signed difference reaches.
    const auto count = [](std::chrono::nanoseconds time) { return static_cast<std::uint64_t>(time.count()); };
    const std::uint64_t beyond = count(moment.time_since_epoch()) - count(passed.time_since_epoch());
    const std::uint64_t sinceTick = beyond % count(*interval);
    const auto tick = moment - std::chrono::nanoseconds(sinceTick);
    return sinceTick == 0 ? tick : tick + *interval;
}

void OfflineMonitor::finish()
{
    if (updated || !interval)
        refresh();
}

void OfflineMonitor::refresh()
{
    updated = false;
    const Value display = generator->generateLogUsingState(state);
    refreshed(*PelorusModelNode::makeTreeFromObject(display), lastMessage);
}

} // namespace pelorus
