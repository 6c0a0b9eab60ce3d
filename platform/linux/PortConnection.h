#pragma once

#include "platform/linux/FileDescriptor.h"
#include "platform/linux/FrameReader.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

class QLocalSocket;

namespace pelorus {

/// One connected socket that carries frames both ways. The peer is of the same user, or there is no
/// connection.
///
/// Callbacks run on the event loop, one at a time, and may close or release the connection they are called
/// for. An exception that leaves one ends the program. A peer that breaks the framing rules is cut off, which
/// looks as if it had closed. A bounded amount is handled before the event loop gets its turn, and a peer
/// that does not read what it is sent is not read from either once kReadWhileUnsent bytes wait for it.
class PortConnection : public std::enable_shared_from_this<PortConnection> {
public:
    using Clock = std::chrono::steady_clock;
    using FrameCallback = std::function<void(PortConnection&, const Frame&)>;
    using Callback = std::function<void(PortConnection&)>;

    static constexpr std::size_t kReadWhileUnsent = 4 * 1024 * 1024;

    /// Null when nobody listens there; `why` is one line with the path.
    static std::shared_ptr<PortConnection>
    connectTo(const std::string& socketPath, std::string& why,
              std::chrono::milliseconds timeout = std::chrono::seconds(1));
    /// Takes over a connected socket; null when the peer is another user's.
    static std::shared_ptr<PortConnection> adopt(std::unique_ptr<QLocalSocket> socket, std::string& why);
    ~PortConnection();

    /// Frames are read only while there is a callback for them; until then they wait in the socket.
    void onFrame(FrameCallback callback);
    /// Called once when the peer closes or is cut off, after the last whole frame. Not called by close().
    void onClosed(Callback callback);
    /// Called whenever unsent() falls to `level` or below.
    void onDrained(Callback callback, std::size_t level = 0);

    /// Puts a frame behind those that wait to be sent; the event loop sends them, many at a time. False, and
    /// nothing is sent, when the connection is closed or the payload is too long. Nothing bounds what waits
    /// but the sender: look at unsent(), and go on in onDrained().
    bool send(const Frame& frame);
    /// Answers a request; nothing is a reply without data.
    bool reply(const Frame& request, std::optional<std::span<const std::byte>> payload);
    /// Bytes that the kernel has not taken yet.
    std::size_t unsent() const;

    /// Also sees that the peer closed when the event loop did not run since.
    bool isOpen() const;
    /// Drops what is unsent and unread. No callback is called any more.
    void close();

    // For callers that cannot return to the event loop. Only this connection's callbacks run in here.
    /// True when nothing is unsent any more.
    bool waitUntilSent(Clock::time_point deadline);
    /// Returns when frames were received, the connection closed (false), or at the deadline (false).
    bool waitForFrames(Clock::time_point deadline);
    /// Delivers the frames that are there already, for who is about to close.
    void deliverArrived();

    PortConnection(const PortConnection&) = delete;
    PortConnection& operator=(const PortConnection&) = delete;

private:
    explicit PortConnection(std::unique_ptr<QLocalSocket> socket);

    void attach();
    void inSignal(void (PortConnection::*handler)());
    bool isHeld() const;
    void receive();
    void handleSent();
    void handlePeerGone();
    void receiveLater();
    std::size_t read(std::span<std::byte> room);
    void keepUnread();
    void end();

    std::unique_ptr<QLocalSocket> socket;
    FrameReader reader;
    FileDescriptor afterlife; // of the socket, while replies are unsent that may fail to be sent
    std::optional<std::vector<std::byte>> kept; // once the peer is gone: what it left, and how much was read
    std::size_t keptRead = 0;
    // Shared, so that one that is running survives being replaced.
    std::shared_ptr<FrameCallback> frameCallback;
    std::shared_ptr<Callback> closedCallback;
    std::shared_ptr<Callback> drainedCallback;
    std::size_t drainedLevel = 0;
    bool open = true;
    bool peerGone = false;
    bool receiving = false;
    int signalDepth = 0;
};

} // namespace pelorus
