#pragma once

#include "LogGenerator/LogGenerator.h"
#include "model/PelorusModelNode.h"
#include "platform/recording/Recording.h"

#include <functional>
#include <optional>

namespace pelorus {

/// Feeds recorded messages to a generator and refreshes as the monitor does, in recorded time.
class OfflineMonitor {
public:
    using Refreshed =
        std::function<void(const PelorusModelNode& root, std::optional<RecordedTime> lastMessage)>;

    /// With an interval there is a refresh at each tick in which a message arrived, counted from the first
    /// message's time; a message exactly on a tick belongs to the tick before.
    OfflineMonitor(std::unique_ptr<LogGenerator> technology, std::optional<std::chrono::nanoseconds> every,
                   Refreshed callback);

    /// For who does not ask for saveContents(): the memory that is used stays the same however long the
    /// recording is.
    void saveNothing() { generator->dropRawMessages(); }
    void receive(const RecordedMessage& message);
    /// The refresh at the end: always without an interval, else when something arrived since the last one.
    void finish();
    std::shared_ptr<Array> saveContents() const { return generator->getSaveContentsFromState(state); }

private:
    void refresh();
    /// The first tick at or after a moment that lies behind the tick that passed.
    RecordedTime tickFrom(RecordedTime passed, RecordedTime moment) const;

    std::unique_ptr<LogGenerator> generator;
    State state;
    std::optional<std::chrono::nanoseconds> interval;
    Refreshed refreshed;
    std::optional<RecordedTime> nextTick;
    std::optional<RecordedTime> lastMessage;
    bool updated = false;
};

} // namespace pelorus
