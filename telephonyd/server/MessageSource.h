#pragma once

#include "telephonyd/server/Subscription.h"

#include <chrono>
#include <cstddef>
#include <functional>
#include <memory>
#include <span>
#include <string>

namespace pelorus {

struct SourceMessage {
    std::chrono::nanoseconds time{};  // on a clock of the source's own
    std::span<const std::byte> bytes; // valid until the next message is taken
};

/// Where the log messages of one channel come from. Each channel has a source of its own, so that every
/// client gets the whole story.
class MessageSource {
public:
    MessageSource() = default;
    virtual ~MessageSource() = default;
    MessageSource(const MessageSource&) = delete;
    MessageSource& operator=(const MessageSource&) = delete;

    /// False when there are no more, or none yet.
    virtual bool next(SourceMessage& message) = 0;
    /// Goes back to the first message. False when that cannot be done.
    virtual bool rewind() = 0;
    /// What the client asked for, told before the first message is taken and whenever it changes.
    virtual void subscribe(const Subscription&) {}
    /// For a source that has no end: `more` is called, from the event loop, when next() has something again.
    /// False when the source ends.
    // NOLINTNEXTLINE(performance-unnecessary-value-param): those who override it keep it
    virtual bool awaitMore(std::function<void()> /*more*/) { return false; }
};

/// Makes the source of a new channel. Null when there is none; `why` is then one line.
using SourceFactory = std::function<std::unique_ptr<MessageSource>(std::string& why)>;

} // namespace pelorus
