#include "platform/linux/RemotePort.h"

#include "platform/linux/MainQueue.h"

namespace pelorus {

std::shared_ptr<RemotePort> RemotePort::connectTo(const std::string& socketPath, std::string& why)
{
    auto connection = PortConnection::connectTo(socketPath, why);
    return connection ? std::shared_ptr<RemotePort>(new RemotePort(std::move(connection))) : nullptr;
}

RemotePort::RemotePort(std::shared_ptr<PortConnection> established)
    : connection(std::move(established)), sender(*connection)
{
    connection->onFrame([this](PortConnection&, const Frame& frame) { sender.takeReply(frame); });
    // The peer's close may be seen in the middle of a send; who sends is not to be called back from there.
    connection->onClosed([this](PortConnection&) {
        postToMainQueue([port = weak_from_this()] {
            if (const auto self = port.lock())
                self->invalidate();
        });
    });
}

RemotePort::~RemotePort()
{
    connection->close();
}

PortReply RemotePort::send(std::int32_t messageId, std::span<const std::byte> payload, Seconds sendTimeout,
                           Seconds receiveTimeout)
{
    return sender.send(messageId, payload, sendTimeout, receiveTimeout);
}

void RemotePort::close()
{
    connection->close();
}

} // namespace pelorus
