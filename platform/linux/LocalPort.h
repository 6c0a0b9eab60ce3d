#pragma once

#include "platform/linux/LinuxMessagePort.h"
#include "platform/linux/PortListener.h"

#include <set>

namespace pelorus {

/// A port that others send to. Whoever connects, the frames go to the one callback.
class LocalPort : public LinuxMessagePort {
public:
    explicit LocalPort(PortMessageCallback callback);
    ~LocalPort() override;

    /// A port that was not listened on delivers nothing, and is valid until it is invalidated.
    PortListener::Outcome listen(const PortDirectory& directory, const std::string& name, std::string& why);
    void startDelivery();
    bool isValid() const override { return !isInvalidated(); }

private:
    void deliverArrived() override;
    void close() override;
    void addConnection(std::shared_ptr<PortConnection> connection);
    void handle(PortConnection& connection, const Frame& frame);

    PortListener listener;
    PortMessageCallback message;
    std::set<std::shared_ptr<PortConnection>> connections;
};

} // namespace pelorus
