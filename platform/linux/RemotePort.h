#pragma once

#include "platform/linux/LinuxMessagePort.h"
#include "platform/linux/RequestSender.h"

namespace pelorus {

/// A connection to somebody else's port. It is valid as long as both sides keep it.
class RemotePort : public LinuxMessagePort {
public:
    /// Null when nobody listens there.
    static std::shared_ptr<RemotePort> connectTo(const std::string& socketPath, std::string& why);
    ~RemotePort() override;

    PortReply send(std::int32_t messageId, std::span<const std::byte> payload, Seconds sendTimeout,
                   Seconds receiveTimeout);
    bool isValid() const override { return connection->isOpen(); }

private:
    explicit RemotePort(std::shared_ptr<PortConnection> connection);
    void close() override;

    std::shared_ptr<PortConnection> connection;
    RequestSender sender;
};

} // namespace pelorus
