#pragma once

#include "platform/PropertyList.h"
#include "platform/linux/PortListener.h"

#include <vector>

namespace pelorus::test {

/// The other end of a log channel, on this process's event loop.
class TestClient {
public:
    /// With `reads` false it lets the messages lie.
    explicit TestClient(std::string portName, bool reads = true);

    /// Asks for a channel; the error of the reply, -1 when there is none.
    int createChannel();
    void connectCommands();
    /// The reply's payload, nothing when the reply carries no data.
    std::optional<Value> request(PortConnection& connection, std::int32_t id, const Value& payload);
    std::optional<Value> command(const Value& payload) { return request(*commands, 0, payload); }
    void send(std::span<const std::byte> command);
    /// The start command of an LTE client.
    void start();
    /// All of it, up to the start command.
    void run();

    bool isOpen() const { return port && port->isOpen() && commands && commands->isOpen(); }

    std::string remotePort;               // as the server named it
    std::shared_ptr<PortConnection> port; // the one that the server made last
    std::vector<std::shared_ptr<PortConnection>> earlierPorts;
    std::shared_ptr<PortConnection> commands;
    std::vector<std::vector<std::byte>> messages;
    bool portClosed = false;
    bool commandsClosed = false;

private:
    std::string name;
    PortListener listener;
    std::uint32_t sequence = 0;
};

Value startCommand(std::vector<int> basebandCodes, std::vector<int> serverCodes);
std::string codeOf(const std::vector<std::byte>& message);

} // namespace pelorus::test
