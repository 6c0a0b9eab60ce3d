#pragma once

#include "platform/linux/PortConnection.h"
#include "platform/linux/PortDirectory.h"

#include <sys/types.h>

class QSocketNotifier;

namespace pelorus {

/// A named port that others connect to: a socket file of mode 0600 in the port directory, there as long as
/// the listener listens.
class PortListener {
public:
    enum class Outcome { listening, alreadyExisted, failed };
    using ConnectionCallback = std::function<void(std::shared_ptr<PortConnection>)>;

    PortListener();
    ~PortListener();
    PortListener(const PortListener&) = delete;
    PortListener& operator=(const PortListener&) = delete;

    /// Removes a stale socket file of that name first. `why` is one line that names the socket, set unless
    /// the outcome is `listening`.
    Outcome listen(const PortDirectory& directory, const std::string& name, std::string& why);
    /// Listens on a socket that the service manager made at that name's path, and leaves the file to it.
    Outcome adopt(FileDescriptor listening, const PortDirectory& directory, const std::string& name,
                  std::string& why);
    /// Hands over every connection from now on, those that wait already included. A connection that the
    /// callback does not keep is closed. The callback may close the listener, but not destroy it.
    void acceptConnections(ConnectionCallback callback);
    bool isListening() const { return static_cast<bool>(socket); }
    const std::string& path() const { return socketPath; }
    /// Removes the socket file, if it was made by listen() and is still its own. Connections live on.
    void close();

private:
    void startListening(FileDescriptor listening);
    void acceptSome();
    void pauseAccepting();

    FileDescriptor socket;
    std::unique_ptr<QSocketNotifier> notifier;
    std::optional<PortDirectory> directory; // nothing for a socket that was adopted
    std::string socketPath;
    dev_t device = 0; // which file is this listener's own
    ino_t inode = 0;
    std::shared_ptr<ConnectionCallback> connectionCallback;
    bool accepting = false;
};

} // namespace pelorus
