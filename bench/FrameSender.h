#pragma once

#include "bench/MessageStream.h"
#include "bench/Paired.h"
#include "platform/linux/Frame.h"

#include <algorithm>
#include <csignal>
#include <cstdio>
#include <stdexcept>
#include <string>
#include <sys/socket.h>
#include <sys/un.h>
#include <sys/wait.h>
#include <unistd.h>

namespace pelorus::bench {

/// The address of a Unix-domain socket; a path that is too long is cut, and nobody is there.
inline sockaddr_un addressOf(const std::string& path)
{
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::snprintf(address.sun_path, sizeof address.sun_path, "%s", path.c_str());
    return address;
}

/// Messages as they stand on a port's stream, each behind its header.
class Frames {
public:
    explicit Frames(const MessageStream& stream)
    {
        for (std::size_t index = 0; index < stream.size(); ++index) {
            const auto header = FrameHeader::pack({.payload = stream[index]});
            content.insert(content.end(), header.begin(), header.end());
            content.insert(content.end(), stream[index].begin(), stream[index].end());
            ends.push_back(content.size());
        }
    }

    std::size_t size() const { return ends.size(); }
    /// The frames from `first` on, at most `count` of them.
    std::span<const std::byte> bytes(std::size_t first, std::size_t count) const
    {
        const std::size_t begin = first == 0 ? 0 : ends[first - 1];
        return std::span(content).subspan(begin, ends[std::min(first + count, ends.size()) - 1] - begin);
    }

private:
    std::vector<std::byte> content;
    std::vector<std::size_t> ends;
};

/// A process that, whenever it is told to, connects to a socket and writes all frames as fast as they are
/// taken. It lives as long as this object: a new one for each round would have the receiver's memory copied,
/// page by page, while the receiver is measured.
class FrameSender {
public:
    explicit FrameSender(const Frames& frames)
    {
        int ends[2] = {};
        if (socketpair(AF_UNIX, SOCK_STREAM, 0, ends) != 0)
            throw std::runtime_error("no socket for orders");
        child = fork();
        orders = ends[child == 0 ? 1 : 0];
        close(ends[child == 0 ? 0 : 1]);
        if (child == 0)
            serve(frames);
    }
    ~FrameSender()
    {
        close(orders); // which ends it
        waitpid(child, nullptr, 0);
    }
    FrameSender(const FrameSender&) = delete;
    FrameSender& operator=(const FrameSender&) = delete;

    /// Sends once, so many frames a write.
    void start(const std::string& path, std::size_t framesPerWrite)
    {
        Order order{framesPerWrite, addressOf(path)};
        if (write(orders, &order, sizeof order) != sizeof order)
            throw std::runtime_error("the sender is gone");
    }
    /// Waits until the receiver has closed and the sender noticed. False when not everything was taken.
    bool succeeded()
    {
        bool sent = false;
        return read(orders, &sent, sizeof sent) == sizeof sent && sent;
    }

    /// Of its processor time.
    double seconds() const
    {
        clockid_t clock{};
        clock_getcpuclockid(child, &clock);
        return secondsOf(clock);
    }

private:
    struct Order {
        std::size_t framesPerWrite;
        sockaddr_un address;
    };

    [[noreturn]] void serve(const Frames& frames) const
    {
        signal(SIGPIPE, SIG_IGN);
        Order order{};
        while (read(orders, &order, sizeof order) == sizeof order) {
            const bool sent = carryOut(order, frames);
            if (write(orders, &sent, sizeof sent) != sizeof sent)
                break;
        }
        _exit(0);
    }

    static bool carryOut(const Order& order, const Frames& frames)
    {
        const int peer = socket(AF_UNIX, SOCK_STREAM, 0);
        bool sent =
            connect(peer, reinterpret_cast<const sockaddr*>(&order.address), sizeof order.address) == 0;
        for (std::size_t first = 0; sent && first < frames.size(); first += order.framesPerWrite)
            sent = send(peer, frames.bytes(first, order.framesPerWrite));
        char none = 0;
        [[maybe_unused]] const ssize_t closed = read(peer, &none, 1); // until the receiver is done
        close(peer);
        return sent;
    }

    static bool send(int descriptor, std::span<const std::byte> bytes)
    {
        while (!bytes.empty()) {
            const ssize_t count = write(descriptor, bytes.data(), bytes.size());
            if (count <= 0)
                return false;
            bytes = bytes.subspan(static_cast<std::size_t>(count));
        }
        return true;
    }

    pid_t child = -1;
    int orders = -1;
};

} // namespace pelorus::bench
