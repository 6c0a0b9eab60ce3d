#include "platform/linux/LocalPort.h"

namespace pelorus {

LocalPort::LocalPort(PortMessageCallback callback) : message(std::move(callback)) {}

LocalPort::~LocalPort()
{
    LocalPort::close();
}

PortListener::Outcome LocalPort::listen(const PortDirectory& directory, const std::string& name,
                                        std::string& why)
{
    return listener.listen(directory, name, why);
}

void LocalPort::startDelivery()
{
    listener.acceptConnections(
        [this](std::shared_ptr<PortConnection> connection) { addConnection(std::move(connection)); });
}

/// A sender that is gone may have left messages in the socket.
void LocalPort::deliverArrived()
{
    const auto senders = connections; // one that has ended removes itself
    for (const auto& connection : senders)
        connection->deliverArrived();
}

void LocalPort::close()
{
    listener.close();
    for (const auto& connection : connections)
        connection->close();
    connections.clear();
}

void LocalPort::addConnection(std::shared_ptr<PortConnection> connection)
{
    connection->onFrame([this](PortConnection& from, const Frame& frame) { handle(from, frame); });
    connection->onClosed([this](PortConnection& from) { connections.erase(from.shared_from_this()); });
    connections.insert(std::move(connection));
}

void LocalPort::handle(PortConnection& connection, const Frame& frame)
{
    if (frame.kind == FrameKind::reply)
        return;                           // nothing was asked
    const auto self = shared_from_this(); // the callback may release the port
    const auto answer = message(frame.id, frame.payload);
    if (frame.kind != FrameKind::request)
        return;
    if (answer && answer->size() <= FrameHeader::maximumPayload)
        connection.reply(frame, std::span(*answer));
    else
        connection.reply(frame, std::nullopt);
}

} // namespace pelorus
