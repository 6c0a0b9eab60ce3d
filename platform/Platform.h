#pragma once

#include "platform/Value.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace pelorus {

using Bytes = std::vector<std::byte>;
using Seconds = std::chrono::duration<double>;

/// One end of a message port. Ports are made by the platform and handed out shared; what each one is inside
/// is the platform's business.
class MessagePort {
public:
    virtual ~MessagePort() = default;

protected:
    MessagePort() = default;
    MessagePort(const MessagePort&) = delete;
    MessagePort& operator=(const MessagePort&) = delete;
};

/// What a local port does with one message: (message id, payload) to the payload of the reply, or to none.
using PortMessageCallback = std::function<std::optional<Bytes>(std::int32_t, std::span<const std::byte>)>;
using PortInvalidationCallback = std::function<void(MessagePort&)>;

/// A connection to the telephony server. Released when the last reference goes.
class ServerConnection {
public:
    virtual ~ServerConnection() = default;
};

/// A repeating timer; it runs until invalidate() or destruction.
class RepeatingTimer {
public:
    virtual ~RepeatingTimer() = default;
    virtual void invalidate() = 0;
};

/// Outcome of a send: status 0, or -1 (the send did not complete in time), -2 (no reply came in time), -3
/// (the port is invalid). `reply` is the reply's payload; nothing when none was awaited, or the reply carries
/// none.
struct PortReply {
    std::int32_t status = 0;
    std::optional<Bytes> reply;
};

/// What the program needs from the system. All calls are made and all callbacks run on the main thread.
class Platform {
public:
    virtual ~Platform() = default;

    struct LocalPort {
        std::shared_ptr<MessagePort> port; // null: it could not be made
        bool alreadyExisted = false;       // somebody listens under that name; the port delivers nothing
    };

    // Message ports.
    virtual LocalPort createLocalMessagePort(const std::string& name, PortMessageCallback callback) = 0;
    /// Delivery starts with this call.
    virtual void deliverOnMainQueue(MessagePort& localPort) = 0;
    /// An empty callback clears it. Called once, from invalidatePort() or when the port breaks.
    virtual void setInvalidationCallback(MessagePort& port, PortInvalidationCallback callback) = 0;
    /// Null when nobody listens under that name.
    virtual std::shared_ptr<MessagePort> createRemoteMessagePort(const std::string& name) = 0;
    /// Sends a message and, with a receive timeout above zero, awaits the reply. Returns no later than the
    /// two timeouts together.
    virtual PortReply sendPortRequest(MessagePort& remotePort, std::int32_t messageId,
                                      std::span<const std::byte> payload, Seconds sendTimeout,
                                      Seconds receiveTimeout) = 0;
    virtual bool isPortValid(const MessagePort& port) = 0;
    virtual void invalidatePort(MessagePort& port) = 0;

    // Telephony server.
    /// Null when there is no telephony server. `notification` is called for every server notification.
    virtual std::shared_ptr<ServerConnection> createServerConnection(std::function<void()> notification) = 0;
    struct LogChannel {
        std::int32_t error = 0; // 0 on success; the server's code (1 local port, 2 no baseband, 3 too many
                                // channels), a send status, or -4 for a reply that makes no sense
        std::string remotePort;
    };
    virtual LogChannel createLogChannel(ServerConnection& connection, const std::string& localPortName) = 0;

    // Main queue and run loop.
    virtual void dispatchAsyncOnMain(std::function<void()> closure) = 0;
    virtual void dispatchAfterOnMain(std::chrono::nanoseconds delay, std::function<void()> closure) = 0;
    virtual std::unique_ptr<RepeatingTimer> scheduleRepeatingTimer(Seconds interval,
                                                                   std::function<void()> tick) = 0;

    // Application resources.
    /// Path of the property-list resource of that name (without extension), if there is one.
    virtual std::optional<std::string> findPropertyListResource(const std::string& name) = 0;
    /// Paths of all property-list resources, in ascending order.
    virtual std::vector<std::string> listPropertyListResources() = 0;
    virtual std::optional<std::string> bundleVersion() = 0;

    // Time.
    virtual std::chrono::system_clock::time_point now() = 0;
    struct LocalZone {
        std::chrono::seconds offset{0}; // from UTC, the daylight-saving hour included while it is in effect
        bool daylightSaving = false;
    };
    virtual LocalZone localZone() = 0;

    // Files.
    virtual bool fileExists(const std::string& path) = 0;
    virtual std::optional<Bytes> readFile(const std::string& path) = 0;
    /// Writes the value as an XML property list, in place. False when any of it fails.
    virtual bool writePropertyList(const Value& value, const std::string& path) = 0;
    /// Where snapshot files go; made when it is missing.
    virtual std::string snapshotDirectory() = 0;
};

/// A moment in a date's default textual form, which is UTC: "2012-05-04 09:30:00 +0000".
std::string dateText(std::chrono::system_clock::time_point moment);

} // namespace pelorus
