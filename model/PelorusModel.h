#pragma once

#include "LogGenerator/LogGenerator.h"
#include "model/PelorusModelNode.h"
#include "platform/Platform.h"

#include <chrono>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pelorus {

/// Who shows what the model holds. Called on the main queue.
class PelorusModelObserver {
public:
    virtual ~PelorusModelObserver() = default;
    /// There is new data: topLevelNodes() gives a new tree.
    virtual void updateViewControllerFromModel() = 0;
    /// isConnected() has changed.
    virtual void connectionChanged() {}
};

/// The session with the telephony server's log channel and the display that comes of it. It never stops on
/// its own: every failure tears the channel down and tries again 5 s later, a dead channel restarts at once.
/// Failures go to the system log. The state, and the history in it, lives as long as the model.
class PelorusModel {
public:
    PelorusModel(Platform& platform, PelorusModelObserver& observer);
    PelorusModel(const PelorusModel&) = delete;
    PelorusModel& operator=(const PelorusModel&) = delete;
    ~PelorusModel();

    void startMonitor();
    void restartMonitor();
    void destroyPorts();
    bool isConnected() const { return recvPort && sendPort; }

    void updateWithData(std::span<const std::byte> data);
    /// When the last message came; nothing before the first.
    std::optional<std::chrono::system_clock::time_point> lastMessageTime() const { return lastMessage; }
    void refresh();

    /// The root of the display tree, null without a generator. Builds the tree, and with it a history entry,
    /// when new data came since the last time.
    std::shared_ptr<const PelorusModelNode> topLevelNodes();
    /// Null when there is no node at that path.
    std::shared_ptr<const PelorusModelNode> nodeAtPath(const std::string& path);
    /// Null without a generator.
    std::shared_ptr<Array> getSaveContents() const;

    /// For the program's last moments after an uncaught exception of that name: writes what the history
    /// holds, and what arrived since, as a snapshot "Recovered after NAME". Its path, or nothing and `why`.
    std::optional<std::string> writeRecoverySnapshot(std::string_view exceptionName,
                                                     std::string* why = nullptr);

private:
    bool createPorts();
    void configureGenerator();
    bool openChannel();
    bool sendStartCommand();
    void announceConnection();
    Value recordDisplay();

    Platform& platform;
    PelorusModelObserver& observer;
    std::shared_ptr<MessagePort> recvPort;
    std::shared_ptr<MessagePort> sendPort;
    std::unique_ptr<RepeatingTimer> displayUpdateTimer; // set: the monitor has started
    bool updated = false;
    bool unrecorded = false; // messages arrived that no history entry holds
    bool announcedConnection = false;
    std::optional<std::chrono::system_clock::time_point> lastMessage;
    std::unique_ptr<LogGenerator> logGenerator;
    std::shared_ptr<State> state = std::make_shared<State>();
    std::shared_ptr<const PelorusModelNode> nodes;
    std::unique_ptr<PathDictionary> nodesByPath;
    std::shared_ptr<PelorusModel*> self; // what closures that may outlive the model hold weakly
};

} // namespace pelorus
