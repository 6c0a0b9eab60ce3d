#include "platform/linux/RequestSender.h"

#include <algorithm>
#include <utility>

namespace pelorus {

namespace {

constexpr std::int32_t kNotSent = -1;
constexpr std::int32_t kNoReply = -2;
constexpr std::int32_t kInvalidPort = -3;

using Clock = PortConnection::Clock;

Clock::time_point deadlineAfter(Seconds timeout)
{
    constexpr Seconds longest = std::chrono::hours(24);
    return Clock::now() + std::chrono::ceil<Clock::duration>(std::clamp(timeout, Seconds(0), longest));
}

} // namespace

PortReply RequestSender::send(std::int32_t messageId, std::span<const std::byte> payload, Seconds sendTimeout,
                              Seconds receiveTimeout)
{
    if (!connection.isOpen())
        return {kInvalidPort, std::nullopt};
    const bool awaitsReply = receiveTimeout > Seconds(0);
    if (awaitsReply && ++lastSequence == 0)
        ++lastSequence;

    const auto sendDeadline = deadlineAfter(sendTimeout);
    // First what an earlier send left behind, so that never more than one message waits here.
    const bool sent = connection.waitUntilSent(sendDeadline) &&
                      connection.send({.id = messageId,
                                       .kind = awaitsReply ? FrameKind::request : FrameKind::oneWay,
                                       .sequence = awaitsReply ? lastSequence : 0,
                                       .payload = payload}) &&
                      connection.waitUntilSent(sendDeadline);
    if (!sent)
        return {connection.isOpen() ? kNotSent : kInvalidPort, std::nullopt};
    if (!awaitsReply)
        return {};

    answer.reset();
    awaited = lastSequence;
    const auto receiveDeadline = deadlineAfter(receiveTimeout);
    while (!answer && Clock::now() < receiveDeadline && connection.waitForFrames(receiveDeadline)) {
    }
    awaited = 0;
    return std::exchange(answer, std::nullopt).value_or(PortReply{kNoReply, std::nullopt});
}

void RequestSender::takeReply(const Frame& frame)
{
    if (frame.kind != FrameKind::reply || awaited == 0 || frame.sequence != awaited)
        return;
    answer.emplace();
    if (frame.hasData)
        answer->reply.emplace(frame.payload.begin(), frame.payload.end());
    awaited = 0;
}

} // namespace pelorus
