#include "telephonyd/server/MessageStream.h"

namespace pelorus {

MessageStream::MessageStream(std::unique_ptr<MessageSource> source, Pace pace, bool loop)
    : source(std::move(source)), pace(pace), loop(loop)
{}

void MessageStream::subscribe(const Subscription& wanted)
{
    subscription = wanted;
    source->subscribe(subscription);
    if (pending)
        pending = subscription.wants(message.bytes);
    if (ended && loop) // there was nothing for the subscription before
        ended = !startOver();
}

bool MessageStream::startOver()
{
    sentThisRound = false;
    pace.startOver();
    return source->rewind();
}

bool MessageStream::takeNext()
{
    if (source->next(message)) {
        pace.advance(message.time);
        pending = subscription.wants(message.bytes);
        return true;
    }
    // A round without anything to send would be followed by another one, and another one.
    return loop && sentThisRound && startOver();
}

MessageStream::Pause MessageStream::run(Pace::Time now, MessageSink& sink)
{
    for (int looked = 0; !ended; ++looked) {
        if (looked == kMessagesPerTurn)
            return {Wait::forTurn};
        if (!pending) {
            if (!takeNext()) {
                if (endless)
                    return {Wait::forMore};
                ended = true;
            }
            if (!pending)
                continue;
        }
        if (pace.due() > now)
            return {Wait::untilDue, pace.due()};
        if (!sink.hasRoom(message.bytes.size()))
            return {Wait::forRoom};
        pending = false;
        sentThisRound = true;
        pace.sent();
        sink.send(message.bytes);
    }
    return {Wait::atEnd};
}

} // namespace pelorus
