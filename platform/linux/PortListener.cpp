#include "platform/linux/PortListener.h"

#include "platform/linux/CallbackBoundary.h"

#include <QLocalServer>
#include <QLocalSocket>
#include <QTimer>
#include <atomic>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <fmt/format.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>

namespace pelorus {

namespace {

constexpr int kBacklog = 128;

sockaddr_un addressOf(const std::string& path)
{
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    std::memcpy(address.sun_path, path.data(), std::min(path.size(), sizeof address.sun_path - 1));
    return address;
}

FileDescriptor makeSocket()
{
    return FileDescriptor(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
}

/// Whether connecting to the socket file reaches anybody. A full backlog counts: somebody made it.
bool somebodyListens(const std::string& path)
{
    const FileDescriptor socket = makeSocket();
    const sockaddr_un address = addressOf(path);
    return ::connect(socket.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0 ||
           (errno != ECONNREFUSED && errno != ENOENT);
}

FileDescriptor listenAt(const std::string& path)
{
    FileDescriptor socket = makeSocket();
    const sockaddr_un address = addressOf(path);
    // The file gets the mode that the socket has when it is bound.
    if (socket && ::fchmod(socket.get(), 0600) == 0 &&
        ::bind(socket.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0 &&
        ::listen(socket.get(), kBacklog) == 0)
        return socket;
    return FileDescriptor();
}

/// Unlike any other listener's, so that no clean-up can meet another's file.
std::string temporaryPath(const PortDirectory& directory)
{
    static std::atomic<unsigned> count = 0;
    return fmt::format("{}/.{}.{}", directory.path(), ::getpid(), count++);
}

} // namespace

PortListener::PortListener() = default;

PortListener::~PortListener()
{
    close();
}

PortListener::Outcome PortListener::listen(const PortDirectory& where, const std::string& name,
                                           std::string& why)
{
    close();
    const auto path = where.socketPath(name, why);
    if (!path)
        return Outcome::failed;
    // Two programs that start at once must not each take the other's new socket for a stale one.
    const FileDescriptor lock = where.lock(why);
    if (!lock)
        return Outcome::failed;

    struct stat status = {};
    if (::lstat(path->c_str(), &status) == 0) {
        if (!S_ISSOCK(status.st_mode)) {
            why = fmt::format("{}: is in the way and not a socket", *path);
            return Outcome::failed;
        }
        if (somebodyListens(*path)) {
            why = fmt::format("{}: somebody listens there already", *path);
            return Outcome::alreadyExisted;
        }
    }

    // Listens before it has its name, which then replaces a stale file: whoever finds it can connect.
    const std::string temporary = temporaryPath(where);
    ::unlink(temporary.c_str());
    FileDescriptor socket = listenAt(temporary);
    if (!socket || ::stat(temporary.c_str(), &status) != 0 ||
        ::rename(temporary.c_str(), path->c_str()) != 0) {
        why = fmt::format("{}: cannot listen: {}", *path, std::strerror(errno));
        ::unlink(temporary.c_str());
        return Outcome::failed;
    }
    device = status.st_dev;
    inode = status.st_ino;
    directory = where;
    socketPath = *path;
    server = std::make_unique<QLocalServer>();
    server->listen(socket.release());
    return Outcome::listening;
}

void PortListener::acceptConnections(ConnectionCallback callback)
{
    connectionCallback = std::make_shared<ConnectionCallback>(std::move(callback));
    if (!server)
        return;
    QObject::connect(server.get(), &QLocalServer::newConnection, server.get(), [this] { acceptPending(); });
    QTimer::singleShot(0, server.get(), [this] { acceptPending(); });
}

void PortListener::acceptPending()
{
    accepting = true;
    while (server) {
        std::unique_ptr<QLocalSocket> socket(server->nextPendingConnection());
        if (!socket)
            break;
        std::string why;
        const auto callback = connectionCallback;
        if (auto connection = PortConnection::adopt(std::move(socket), why))
            callAtBoundary(*callback, std::move(connection));
    }
    accepting = false;
}

void PortListener::close()
{
    if (!server)
        return;
    std::string why;
    if (const FileDescriptor lock = directory->lock(why)) {
        struct stat status = {};
        if (::lstat(socketPath.c_str(), &status) == 0 && status.st_dev == device && status.st_ino == inode)
            ::unlink(socketPath.c_str());
    }
    server->disconnect();
    server->close();
    if (accepting)
        server.release()->deleteLater(); // inside its own signal
    server.reset();
}

} // namespace pelorus
