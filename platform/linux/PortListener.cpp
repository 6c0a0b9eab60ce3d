#include "platform/linux/PortListener.h"

#include "platform/linux/CallbackBoundary.h"

#include <QLocalSocket>
#include <QSocketNotifier>
#include <QTimer>
#include <atomic>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <fcntl.h>
#include <fmt/format.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>

namespace pelorus {

namespace {

constexpr int kBacklog = 128;
constexpr int kAcceptedPerTurn = 32;
constexpr std::chrono::milliseconds kPauseWithoutDescriptors{500};

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

/// Where a Unix-domain stream socket listens; nothing for a descriptor of another kind.
std::optional<std::string> pathOfListener(int descriptor)
{
    int type = 0;
    int listens = 0;
    socklen_t length = sizeof(int);
    sockaddr_un address = {};
    socklen_t addressLength = sizeof address;
    if (::getsockopt(descriptor, SOL_SOCKET, SO_TYPE, &type, &length) != 0 || type != SOCK_STREAM ||
        ::getsockopt(descriptor, SOL_SOCKET, SO_ACCEPTCONN, &listens, &length) != 0 || listens == 0 ||
        ::getsockname(descriptor, reinterpret_cast<sockaddr*>(&address), &addressLength) != 0 ||
        address.sun_family != AF_UNIX)
        return std::nullopt;
    return std::string(address.sun_path, ::strnlen(address.sun_path, sizeof address.sun_path));
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
    FileDescriptor made = listenAt(temporary);
    if (!made || ::stat(temporary.c_str(), &status) != 0 || ::rename(temporary.c_str(), path->c_str()) != 0) {
        why = fmt::format("{}: cannot listen: {}", *path, std::strerror(errno));
        ::unlink(temporary.c_str());
        return Outcome::failed;
    }
    device = status.st_dev;
    inode = status.st_ino;
    directory = where;
    socketPath = *path;
    startListening(std::move(made));
    return Outcome::listening;
}

PortListener::Outcome PortListener::adopt(FileDescriptor listening, const PortDirectory& where,
                                          const std::string& name, std::string& why)
{
    close();
    const auto path = where.socketPath(name, why);
    if (!path)
        return Outcome::failed;
    const auto boundTo = pathOfListener(listening.get());
    if (!boundTo) {
        why = "the socket that was passed is not a Unix-domain stream socket that listens";
        return Outcome::failed;
    }
    if (*boundTo != *path) {
        why = fmt::format("{}: the socket that was passed listens at {}", *path, *boundTo);
        return Outcome::failed;
    }
    ::fcntl(listening.get(), F_SETFL, ::fcntl(listening.get(), F_GETFL) | O_NONBLOCK);
    directory.reset();
    socketPath = *path;
    startListening(std::move(listening));
    return Outcome::listening;
}

void PortListener::startListening(FileDescriptor listening)
{
    socket = std::move(listening);
    notifier = std::make_unique<QSocketNotifier>(socket.get(), QSocketNotifier::Read);
    notifier->setEnabled(false);
    QObject::connect(notifier.get(), &QSocketNotifier::activated, notifier.get(), [this] { acceptSome(); });
}

void PortListener::acceptConnections(ConnectionCallback callback)
{
    connectionCallback = std::make_shared<ConnectionCallback>(std::move(callback));
    if (notifier)
        notifier->setEnabled(true);
}

void PortListener::acceptSome()
{
    accepting = true;
    for (int accepted = 0; socket && accepted < kAcceptedPerTurn; ++accepted) {
        FileDescriptor connected(::accept4(socket.get(), nullptr, nullptr, SOCK_CLOEXEC | SOCK_NONBLOCK));
        if (!connected) {
            if (errno == EMFILE || errno == ENFILE || errno == ENOBUFS || errno == ENOMEM)
                pauseAccepting();
            break;
        }
        auto peer = std::make_unique<QLocalSocket>();
        if (!peer->setSocketDescriptor(connected.get()))
            continue;
        connected.release();
        std::string why;
        const auto callback = connectionCallback;
        if (auto connection = PortConnection::adopt(std::move(peer), why))
            callAtBoundary(*callback, std::move(connection));
    }
    accepting = false;
}

/// What waits would otherwise wake the event loop without end.
void PortListener::pauseAccepting()
{
    notifier->setEnabled(false);
    QTimer::singleShot(kPauseWithoutDescriptors, notifier.get(),
                       [waiting = notifier.get()] { waiting->setEnabled(true); });
}

void PortListener::close()
{
    if (!socket)
        return;
    std::string why;
    if (const FileDescriptor lock = directory ? directory->lock(why) : FileDescriptor()) {
        struct stat status = {};
        if (::lstat(socketPath.c_str(), &status) == 0 && status.st_dev == device && status.st_ino == inode)
            ::unlink(socketPath.c_str());
    }
    notifier->setEnabled(false);
    if (accepting)
        notifier.release()->deleteLater(); // inside its own signal
    notifier.reset();
    socket.close();
}

} // namespace pelorus
