#pragma once

#include "platform/Platform.h"
#include "platform/linux/PortDirectory.h"
#include "platform/linux/ResourceDirectory.h"

class QObject;

namespace pelorus {

/// The platform on Qt's event loop: ports are sockets (PortListener, PortConnection), the main queue is the
/// application object's event queue. Make it after the QCoreApplication and drop it before; ports and timers
/// may outlive it, but then do nothing any more.
class LinuxPlatform : public Platform {
public:
    /// Property-list resources are in that directory; empty: beside the program.
    explicit LinuxPlatform(const std::string& resourceDirectory = {});
    ~LinuxPlatform() override;

    LocalPort createLocalMessagePort(const std::string& name, PortMessageCallback callback) override;
    void deliverOnMainQueue(MessagePort& localPort) override;
    void setInvalidationCallback(MessagePort& port, PortInvalidationCallback callback) override;
    std::shared_ptr<MessagePort> createRemoteMessagePort(const std::string& name) override;
    PortReply sendPortRequest(MessagePort& remotePort, std::int32_t messageId,
                              std::span<const std::byte> payload, Seconds sendTimeout,
                              Seconds receiveTimeout) override;
    bool isPortValid(const MessagePort& port) override;
    void invalidatePort(MessagePort& port) override;

    std::shared_ptr<ServerConnection> createServerConnection(std::function<void()> notification) override;
    LogChannel createLogChannel(ServerConnection& connection, const std::string& localPortName) override;

    void dispatchAsyncOnMain(std::function<void()> closure) override;
    void dispatchAfterOnMain(std::chrono::nanoseconds delay, std::function<void()> closure) override;
    std::unique_ptr<RepeatingTimer> scheduleRepeatingTimer(Seconds interval,
                                                           std::function<void()> tick) override;

    std::optional<std::string> findPropertyListResource(const std::string& name) override;
    std::vector<std::string> listPropertyListResources() override;
    std::optional<std::string> bundleVersion() override;

    std::chrono::system_clock::time_point now() override;
    LocalZone localZone() override;

    bool fileExists(const std::string& path) override;
    std::optional<Bytes> readFile(const std::string& path) override;
    bool writePropertyList(const Value& value, const std::string& path) override;
    std::string snapshotDirectory() override;

private:
    std::optional<PortDirectory> openPortDirectory();
    /// Says once why ports cannot be used, not at each of the retries that follow.
    void reportPortTrouble(const std::string& why);

    ResourceDirectory resources;
    std::unique_ptr<QObject> mainQueue; // what is queued or timed goes with it
    std::string reportedTrouble;
};

} // namespace pelorus
