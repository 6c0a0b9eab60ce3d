#pragma once

#include "platform/linux/PortListener.h"
#include "telephonyd/server/MessageRecorder.h"
#include "telephonyd/server/MessageStream.h"

#include <QElapsedTimer>
#include <QTimer>

namespace pelorus {

/// One client's log channel: messages go to the client's own port, commands come on a port made for it. The
/// channel lives as long as both.
class LogChannel : private MessageSink {
public:
    /// So much waits for the client at most, then the source waits.
    static constexpr std::size_t kMostUnsent = 1024 * 1024;

    struct Setup {
        unsigned number = 0; // names the channel in reports
        std::string technology;
        std::shared_ptr<PortConnection> client;
        std::unique_ptr<PortListener> commandPort;
        MessageStream stream;
        std::chrono::milliseconds patience; // how long the client may take to connect to its command port
        MessageRecorder* recorder = nullptr;
        Report report;
        std::function<void()> ended; // called once; may keep the channel for a while, not destroy it
    };

    explicit LogChannel(Setup setup);
    ~LogChannel() override;
    LogChannel(const LogChannel&) = delete;
    LogChannel& operator=(const LogChannel&) = delete;

    /// Closes both ports, so that the client comes back and asks anew.
    void drop(const std::string& reason);

private:
    void takeCommandConnection(std::shared_ptr<PortConnection> connection);
    void handle(PortConnection& connection, const Frame& frame);
    std::optional<std::vector<std::byte>> answer(const Frame& frame);
    void start(const Value& command);
    void pump();
    bool hasRoom(std::size_t length) const override;
    void send(std::span<const std::byte> message) override;
    void end(const std::string& how);
    void close();
    void say(const std::string& what) const;

    Setup setup;
    std::shared_ptr<PortConnection> commands;
    QTimer patienceTimer;
    QTimer pumpTimer;
    QElapsedTimer sinceStart; // invalid before the start command
    bool waitsForRoom = false;
    bool atEnd = false;
    bool hasEnded = false;
};

} // namespace pelorus
