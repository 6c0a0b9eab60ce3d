#pragma once

#include "telephonyd/server/MessageSource.h"
#include "telephonyd/server/Pace.h"

namespace pelorus {

/// What takes the messages of a stream.
class MessageSink {
public:
    virtual ~MessageSink() = default;

    /// Whether a message of that length may be sent now.
    virtual bool hasRoom(std::size_t length) const = 0;
    virtual void send(std::span<const std::byte> message) = 0;
};

/// Takes messages from a source and sends those that are subscribed to, when they are due. Knows neither
/// clocks nor sockets: it is told the time, and tells what it waits for.
class MessageStream {
public:
    enum class Wait { untilDue, forRoom, forTurn, forMore, atEnd };
    struct Pause {
        Wait wait;
        Pace::Time due{}; // with untilDue
    };
    /// So many messages of the source are looked at before others get their turn.
    static constexpr int kMessagesPerTurn = 8192;

    MessageStream(std::unique_ptr<MessageSource> source, Pace pace, bool loop);

    /// Replaces the subscription; before there is one, nothing is sent.
    void subscribe(const Subscription& wanted);
    /// Called when a stream that waited forMore has some.
    void onMore(std::function<void()> callback) { endless = source->awaitMore(std::move(callback)); }
    /// Sends what is due `now`, counted from the start of the stream.
    Pause run(Pace::Time now, MessageSink& sink);

private:
    bool takeNext();
    bool startOver();

    std::unique_ptr<MessageSource> source;
    Pace pace;
    bool loop;
    Subscription subscription;
    SourceMessage message;
    bool pending = false; // `message` is still to be sent
    bool ended = false;
    bool endless = false;
    bool sentThisRound = false;
};

} // namespace pelorus
