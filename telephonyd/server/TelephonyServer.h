#pragma once

#include "telephonyd/server/LogChannel.h"

#include <map>
#include <set>

namespace pelorus {

/// Makes log channels for whoever asks on its port, and keeps them.
class TelephonyServer {
public:
    static constexpr std::size_t kMostChannels = 256;
    static constexpr std::size_t kMostConnections = 512; // of clients that want a channel

    struct Settings {
        std::string technology; // the answer to "GetTechnology"; may change, see below
        SourceFactory makeSource;
        Pace pace = Pace::ownTiming(1);
        bool loop = false;
        Report report;
        std::chrono::milliseconds patience = std::chrono::seconds(10);
    };

    TelephonyServer(PortDirectory directory, Settings settings);
    ~TelephonyServer();
    TelephonyServer(const TelephonyServer&) = delete;
    TelephonyServer& operator=(const TelephonyServer&) = delete;

    /// `why` is one line, set unless the outcome is `listening`.
    PortListener::Outcome listen(std::string& why);
    /// Listens on a socket that somebody made for that.
    PortListener::Outcome listenOn(FileDescriptor socket, std::string& why);
    /// Records what the channels made from now on stream. The recorder outlives the server.
    void recordTo(MessageRecorder& messageRecorder) { recorder = &messageRecorder; }
    /// From now on, those that wait already included.
    void acceptClients();
    /// What clients are told from now on. Channels of another technology are dropped: their clients come
    /// back.
    void changeTechnology(const std::string& technology);
    void dropChannels(const std::string& reason);
    const std::string& path() const { return listener.path(); }
    std::size_t channelCount() const { return channels.size(); }

private:
    enum Error { none = 0, unreachable = 1, noBaseband = 2, tooManyChannels = 3 };

    void take(std::shared_ptr<PortConnection> connection);
    void handle(PortConnection& connection, const Frame& frame);
    Error createChannel(const std::string& localPort, std::string& remotePort, std::string& why);
    void remove(unsigned number);
    void reportRefusal(Error error, const std::string& why);

    PortDirectory directory;
    Settings settings;
    MessageRecorder* recorder = nullptr;
    PortListener listener;
    std::set<std::shared_ptr<PortConnection>> connections;
    std::map<unsigned, std::shared_ptr<LogChannel>> channels;
    unsigned lastNumber = 0;
    std::string lastRefusal; // clients try again every few seconds
};

} // namespace pelorus
