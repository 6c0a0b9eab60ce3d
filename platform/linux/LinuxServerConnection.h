#pragma once

#include "platform/linux/PortDirectory.h"
#include "platform/linux/RequestSender.h"

namespace pelorus {

/// The client's connection to the telephony server.
class LinuxServerConnection : public ServerConnection {
public:
    /// Null when there is no telephony server. `notification` runs from the event loop, never inside a
    /// request.
    static std::shared_ptr<LinuxServerConnection> open(const PortDirectory& directory,
                                                       std::function<void()> notification, std::string& why);
    ~LinuxServerConnection() override;

    Platform::LogChannel createLogChannel(const std::string& localPortName);

private:
    LinuxServerConnection(std::shared_ptr<PortConnection> connection, std::function<void()> notification);
    void handle(const Frame& frame);

    std::shared_ptr<PortConnection> connection;
    RequestSender sender;
    std::shared_ptr<std::function<void()>> notification;
};

} // namespace pelorus
