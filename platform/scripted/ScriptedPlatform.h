#pragma once

#include "platform/Platform.h"

#include <chrono>
#include <map>

namespace pelorus {

/// A port of the scripted platform: plain data that a test may look at.
class ScriptedPort : public MessagePort {
public:
    std::string name;
    bool local = false;
    bool valid = true;
    bool delivering = false;
    PortMessageCallback message;
    PortInvalidationCallback invalidation;
};

/// What a send looked like.
struct SentMessage {
    std::string port = {};
    std::int32_t id = 0;
    Bytes payload = {};
    Seconds sendTimeout{0};
    Seconds receiveTimeout{0};
    std::chrono::nanoseconds when{0}; // on the virtual clock

    Value propertyList() const;
};

/// A machine that does what a test says. Set the script's members, run the code under test, move the clock
/// with advance() (nothing timed or queued runs by itself), then look at what was recorded:
///
///     ScriptedPlatform platform;
///     platform.answerTechnology("Osprey LTE");
///     model.startMonitor();
///     platform.deliver(packet);
///     platform.advance(2s);
///     EXPECT_EQ(platform.sent.back().propertyList().dictionary()->size(), 1u);
class ScriptedPlatform : public Platform {
public:
    ScriptedPlatform();
    ~ScriptedPlatform() override;

    // The script.
    bool localPortFails = false;   // no local port can be made
    bool localPortExisted = false; // somebody else listens under its name
    bool serverPresent = true;
    std::int32_t logChannelError = 0;
    std::string remotePortName = "io.pelorus.ScriptedRemotePort"; // what the server names; may be empty
    bool remotePortFails = false;                                 // nobody listens under that name
    PortReply requestAnswer;                                      // to a send that awaits a reply
    std::int32_t oneWayStatus = 0;                                // of a send that awaits none
    std::chrono::nanoseconds sendDuration{0}; // every send blocks the main thread for so long
    std::function<void()> duringLogChannel;   // runs while the server connection exists
    bool writesFail = false;
    std::optional<std::string> version = "1.0.0";
    LocalZone zone;
    std::string crashReports = "/crash-reports"; // answer of snapshotDirectory()
    std::map<std::string, Bytes> files;          // what fileExists() and readFile() see

    /// Every awaited send is answered with a dictionary that has this value under "GetTechnology".
    void answerTechnology(std::string_view technology);
    void answerWith(std::string_view bytes);
    void addFile(const std::string& path, std::string_view content);
    void addResource(const std::string& name, std::string_view propertyList);
    /// Resources are those of a directory on disk, besides the added ones.
    void useResourceDirectory(const std::string& path) { diskResources = path; }
    /// The wall clock; it moves with advance().
    void setNow(std::chrono::system_clock::time_point moment) { wallClockStart = moment - elapsed; }

    // Events.
    /// Runs what is queued and what becomes due, in the order of time.
    void advance(std::chrono::nanoseconds duration);
    void runMainQueue();
    /// A message from the server; false when no local port takes it. Its reply is then in lastReply.
    bool deliver(std::span<const std::byte> payload, std::int32_t id = 0);
    bool deliver(std::string_view payload, std::int32_t id = 0);
    /// The port breaks by itself, as when its peer goes.
    void breakPort(ScriptedPort& port);
    /// Calls the callbacks of the server connections that exist; returns how many.
    int notifyFromServer();

    // The record.
    std::vector<std::string> calls; // port and server operations as "operation argument", in order
    std::vector<SentMessage> sent;
    std::optional<Bytes> lastReply;
    std::map<std::string, Value> written; // deep copies of the property lists, by path
    std::chrono::nanoseconds elapsed{0};
    /// The port made last, null when it is gone.
    std::shared_ptr<ScriptedPort> localPort() const { return lastLocalPort.lock(); }
    std::shared_ptr<ScriptedPort> remotePort() const { return lastRemotePort.lock(); }
    std::size_t repeatingTimers() const; // that run now
    std::size_t waitingClosures() const; // queued or delayed

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
    std::optional<std::string> bundleVersion() override { return version; }
    std::chrono::system_clock::time_point now() override;
    LocalZone localZone() override { return zone; }
    bool fileExists(const std::string& path) override;
    std::optional<Bytes> readFile(const std::string& path) override;
    bool writePropertyList(const Value& value, const std::string& path) override;
    std::string snapshotDirectory() override { return crashReports; }

private:
    struct Schedule;
    class Timer;
    class Connection;

    bool isDiskResource(const std::string& path) const;

    std::shared_ptr<Schedule> schedule; // shared with timers, which may outlive the platform
    std::shared_ptr<std::vector<Connection*>> connections;
    std::weak_ptr<ScriptedPort> lastLocalPort;
    std::weak_ptr<ScriptedPort> lastRemotePort;
    std::optional<std::string> diskResources;
    std::chrono::system_clock::time_point wallClockStart{};
};

} // namespace pelorus
