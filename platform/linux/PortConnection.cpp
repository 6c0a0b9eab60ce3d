#include "platform/linux/PortConnection.h"

#include "platform/linux/CallbackBoundary.h"

#include <QLocalSocket>
#include <QTimer>
#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <fmt/format.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

namespace pelorus {

namespace {

/// As much as one wake-up handles, and as much as is held unread.
constexpr std::size_t kReadBuffer = 64 * 1024;

bool isOwnUser(const QLocalSocket& socket, std::string& why)
{
    ucred peer = {};
    socklen_t length = sizeof peer;
    const auto descriptor = static_cast<int>(socket.socketDescriptor());
    if (::getsockopt(descriptor, SOL_SOCKET, SO_PEERCRED, &peer, &length) != 0) {
        why = fmt::format("unknown peer: {}", std::strerror(errno));
        return false;
    }
    if (peer.uid != ::geteuid()) {
        why = fmt::format("process {} of user {} is not let in", peer.pid, peer.uid);
        return false;
    }
    return true;
}

int millisecondsUntil(PortConnection::Clock::time_point deadline)
{
    const auto left =
        std::chrono::ceil<std::chrono::milliseconds>(deadline - PortConnection::Clock::now()).count();
    return static_cast<int>(std::clamp<std::int64_t>(left, 0, 24 * 3600 * 1000));
}

} // namespace

std::shared_ptr<PortConnection> PortConnection::connectTo(const std::string& socketPath, std::string& why,
                                                          std::chrono::milliseconds timeout)
{
    auto socket = std::make_unique<QLocalSocket>();
    socket->connectToServer(QString::fromStdString(socketPath));
    if (!socket->waitForConnected(static_cast<int>(timeout.count()))) {
        const bool nobody = socket->error() == QLocalSocket::ServerNotFoundError ||
                            socket->error() == QLocalSocket::ConnectionRefusedError;
        why = fmt::format("{}: {}", socketPath,
                          nobody ? "nobody listens there" : socket->errorString().toStdString());
        return nullptr;
    }
    auto connection = adopt(std::move(socket), why);
    if (!connection)
        why = fmt::format("{}: {}", socketPath, why);
    return connection;
}

std::shared_ptr<PortConnection> PortConnection::adopt(std::unique_ptr<QLocalSocket> socket, std::string& why)
{
    if (!isOwnUser(*socket, why))
        return nullptr;
    std::shared_ptr<PortConnection> connection(new PortConnection(std::move(socket)));
    connection->attach();
    return connection;
}

PortConnection::PortConnection(std::unique_ptr<QLocalSocket> socket) : socket(std::move(socket)) {}

PortConnection::~PortConnection()
{
    socket->disconnect();
    socket->abort();
    if (signalDepth > 0)
        socket.release()->deleteLater(); // it is still at work on the signal that led here
}

void PortConnection::attach()
{
    socket->setParent(nullptr);
    socket->setReadBufferSize(kReadBuffer);
    const auto on = [this](auto signal, void (PortConnection::*handler)()) {
        QObject::connect(socket.get(), signal, socket.get(), [this, handler] { inSignal(handler); });
    };
    on(&QLocalSocket::readyRead, &PortConnection::receive);
    on(&QLocalSocket::bytesWritten, &PortConnection::handleSent);
    on(&QLocalSocket::disconnected, &PortConnection::handlePeerGone);
    QObject::connect(socket.get(), &QLocalSocket::errorOccurred, socket.get(),
                     [this](QLocalSocket::LocalSocketError error) {
                         if (error == QLocalSocket::PeerClosedError)
                             keepUnread();
                     });
    receiveLater(); // what came before the signals were connected
}

void PortConnection::inSignal(void (PortConnection::*handler)())
{
    const auto self = shared_from_this();
    ++signalDepth;
    (this->*handler)();
    if (self.use_count() > 1)
        --signalDepth; // else the connection ends here, inside the signal
}

/// Whether anybody but the running handlers still refers to the connection.
bool PortConnection::isHeld() const
{
    return weak_from_this().use_count() > signalDepth;
}

void PortConnection::receiveLater()
{
    QTimer::singleShot(0, socket.get(), [this] { inSignal(&PortConnection::receive); });
}

void PortConnection::receive()
{
    if (receiving)
        return; // a frame callback waits: its frame's payload must stay where it is
    receiving = true;
    while (open && isHeld() && frameCallback && (peerGone || unsent() <= kReadWhileUnsent)) {
        if (const auto frame = reader.next()) {
            const auto callback = frameCallback;
            callAtBoundary(*callback, *this, *frame);
            continue;
        }
        if (reader.isCutOff()) {
            peerGone = true;
            break;
        }
        const auto room = reader.room();
        const std::size_t count = read(room);
        if (count == 0)
            break;
        reader.received(count);
    }
    receiving = false;
    if (open && isHeld() && peerGone && frameCallback)
        end();
}

std::size_t PortConnection::read(std::span<std::byte> room)
{
    if (!kept) {
        const auto count =
            socket->read(reinterpret_cast<char*>(room.data()), static_cast<qint64>(room.size()));
        return count > 0 ? static_cast<std::size_t>(count) : 0;
    }
    const auto unread = std::span(*kept).subspan(keptRead);
    const std::size_t count = std::min(room.size(), unread.size());
    std::ranges::copy(unread.first(count), room.begin());
    keptRead += count;
    return count;
}

/// A write that fails closes the socket, and with it goes what the peer sent before it went.
void PortConnection::keepUnread()
{
    if (kept || !open)
        return;
    const QByteArray buffered = socket->readAll();
    const auto bytes = std::as_bytes(std::span(buffered.data(), static_cast<std::size_t>(buffered.size())));
    kept.emplace(bytes.begin(), bytes.end());
    for (ssize_t count = afterlife ? 1 : 0; count > 0;) {
        const std::size_t length = kept->size();
        kept->resize(length + kReadBuffer);
        count = ::recv(afterlife.get(), kept->data() + length, kReadBuffer, MSG_DONTWAIT);
        kept->resize(length + static_cast<std::size_t>(std::max<ssize_t>(count, 0)));
    }
    afterlife = FileDescriptor();
}

void PortConnection::handleSent()
{
    if (unsent() == 0)
        afterlife = FileDescriptor();
    if (const auto callback = drainedCallback; open && callback && unsent() <= drainedLevel)
        callAtBoundary(*callback, *this);
    receive(); // it pauses while too much is unsent
}

void PortConnection::handlePeerGone()
{
    peerGone = true;
    if (!receiving)
        receive();
}

/// The peer's end, after its last frame.
void PortConnection::end()
{
    const auto callback = closedCallback;
    close();
    if (callback)
        callAtBoundary(*callback, *this);
}

void PortConnection::onFrame(FrameCallback callback)
{
    frameCallback = callback ? std::make_shared<FrameCallback>(std::move(callback)) : nullptr;
    if (frameCallback)
        receiveLater();
}

void PortConnection::onClosed(Callback callback)
{
    closedCallback = callback ? std::make_shared<Callback>(std::move(callback)) : nullptr;
}

void PortConnection::onDrained(Callback callback, std::size_t level)
{
    drainedCallback = callback ? std::make_shared<Callback>(std::move(callback)) : nullptr;
    drainedLevel = level;
}

bool PortConnection::send(const Frame& frame)
{
    if (!open || peerGone || frame.payload.size() > FrameHeader::maximumPayload)
        return false;
    const auto header = FrameHeader::pack(frame);
    const auto write = [this](std::span<const std::byte> bytes) {
        socket->write(reinterpret_cast<const char*>(bytes.data()), static_cast<qint64>(bytes.size()));
    };
    write(header);
    write(frame.payload);
    return true;
}

bool PortConnection::reply(const Frame& request, std::optional<std::span<const std::byte>> payload)
{
    // Only who asks is asked: one that goes before its answers may have said more.
    if (open && !peerGone && !afterlife)
        afterlife = FileDescriptor(::fcntl(static_cast<int>(socket->socketDescriptor()), F_DUPFD_CLOEXEC, 0));
    return send({.id = request.id,
                 .kind = FrameKind::reply,
                 .sequence = request.sequence,
                 .payload = payload.value_or(std::span<const std::byte>()),
                 .hasData = payload.has_value()});
}

std::size_t PortConnection::unsent() const
{
    return static_cast<std::size_t>(socket->bytesToWrite());
}

bool PortConnection::isOpen() const
{
    if (!open || peerGone)
        return false;
    pollfd state = {static_cast<int>(socket->socketDescriptor()), POLLRDHUP, 0};
    return ::poll(&state, 1, 0) == 0 || (state.revents & (POLLRDHUP | POLLHUP | POLLERR | POLLNVAL)) == 0;
}

void PortConnection::close()
{
    open = false;
    frameCallback.reset();
    closedCallback.reset();
    drainedCallback.reset();
    afterlife = FileDescriptor();
    socket->abort();
}

bool PortConnection::waitUntilSent(Clock::time_point deadline)
{
    const auto self = shared_from_this();
    for (socket->flush(); open && !peerGone && unsent() > 0;)
        if (const int wait = millisecondsUntil(deadline); wait == 0 || !socket->waitForBytesWritten(wait))
            break;
    return open && !peerGone && unsent() == 0;
}

bool PortConnection::waitForFrames(Clock::time_point deadline)
{
    const auto self = shared_from_this();
    return open && !peerGone && socket->waitForReadyRead(millisecondsUntil(deadline)) && open && !peerGone;
}

void PortConnection::deliverArrived()
{
    const auto self = shared_from_this();
    inSignal(&PortConnection::receive);
    // What a socket holds is less: a peer that goes on sending has no end.
    constexpr int mostRounds = 64;
    for (int round = 0; round < mostRounds && open && !peerGone && !receiving; ++round)
        if (!socket->waitForReadyRead(0))
            break;
}

} // namespace pelorus
