#pragma once

#include "platform/Platform.h"
#include "platform/linux/PortConnection.h"

namespace pelorus {

/// The asking end of a connection: sends, and waits without the event loop until it is sent or answered. It
/// does not take the connection's frames itself; its owner passes the replies on.
class RequestSender {
public:
    explicit RequestSender(PortConnection& connection) : connection(connection) {}

    PortReply send(std::int32_t messageId, std::span<const std::byte> payload, Seconds sendTimeout,
                   Seconds receiveTimeout);
    void takeReply(const Frame& frame);

private:
    PortConnection& connection;
    std::uint32_t lastSequence = 0;
    std::uint32_t awaited = 0; // 0: none, so that a reply that comes too late finds nobody
    std::optional<PortReply> answer;
};

} // namespace pelorus
