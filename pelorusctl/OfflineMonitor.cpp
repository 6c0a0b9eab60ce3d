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
        // The tick at or after this message.
        const auto beyond = message.time - *nextTick - std::chrono::nanoseconds(1);
        *nextTick += (beyond / *interval + 1) * *interval;
    }
    generator->updateState(state, message.bytes);
    lastMessage = message.time;
    updated = true;
}

void OfflineMonitor::finish()
{
    if (updated || !interval)
        refresh();
}

void OfflineMonitor::refresh()
{
    updated = false;
    PathDictionary paths;
    const Value display = generator->generateLogUsingState(state);
    refreshed(*PelorusModelNode::makeTreeFromObject(display, paths), lastMessage);
}

} // namespace pelorus
