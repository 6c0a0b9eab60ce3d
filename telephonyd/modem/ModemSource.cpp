#include "telephonyd/modem/ModemSource.h"

#include "telephonyd/simulation/MessageBatch.h"

#include <algorithm>

namespace pelorus {

namespace {

std::vector<std::byte> messageOf(std::uint32_t code, std::span<const std::byte> list)
{
    MessageBatch batch(std::chrono::system_clock::now());
    batch.list(code, list);
    const std::span<const std::byte> bytes = batch[0].bytes;
    return {bytes.begin(), bytes.end()};
}

} // namespace

ModemSource::ModemSource(ModemFeed& from) : feed(&from)
{
    timer.setSingleShot(true);
    QObject::connect(&timer, &QTimer::timeout, &timer, [this] { handleNews(); });
    feed->add(*this);
}

ModemSource::~ModemSource()
{
    if (feed)
        feed->remove(*this);
}

bool ModemSource::next(SourceMessage& message)
{
    if (!feed)
        return false;
    const auto now = Clock::now();
    for (std::size_t index = 0; index < sent.size(); ++index) {
        const std::uint32_t code = ModemFeed::kCodes[index];
        const std::vector<std::byte>& list = feed->list(code);
        if (!wants(code) || list.empty() ||
            (list == sent[index].list && now < sent[index].time + feed->repetition()))
            continue;
        sent[index] = {list, now};
        current = messageOf(code, list);
        message = {now - began, current};
        return true;
    }
    arm();
    return false;
}

void ModemSource::arm()
{
    auto earliest = Clock::time_point::max();
    for (std::size_t index = 0; index < sent.size(); ++index)
        if (wants(ModemFeed::kCodes[index]) && !sent[index].list.empty())
            earliest = std::min(earliest, sent[index].time + feed->repetition());
    if (earliest == Clock::time_point::max())
        return;
    const auto wait = std::chrono::ceil<std::chrono::milliseconds>(earliest - Clock::now());
    timer.start(std::max(wait, std::chrono::milliseconds(1)));
}

void ModemSource::subscribe(const Subscription& wanted)
{
    subscription = wanted;
    if (feed)
        feed->handleWishes();
}

bool ModemSource::awaitMore(std::function<void()> callback)
{
    more = std::move(callback);
    return true;
}

void ModemSource::handleNews()
{
    if (more)
        more();
}

} // namespace pelorus
