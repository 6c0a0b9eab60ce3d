#pragma once

#include "bench/MessageStream.h"
#include "platform/linux/Frame.h"

#include <cstdio>
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

/// A process that connects to a socket and writes all frames, so many a write, as fast as they are taken.
class FrameSender {
public:
    FrameSender(const std::string& path, const Frames& frames, std::size_t framesPerWrite) : child(fork())
    {
        if (child != 0)
            return;
        const sockaddr_un address = addressOf(path);
        const int descriptor = socket(AF_UNIX, SOCK_STREAM, 0);
        if (connect(descriptor, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0)
            _exit(1);
        for (std::size_t first = 0; first < frames.size(); first += framesPerWrite)
            send(descriptor, frames.bytes(first, framesPerWrite));
        char none = 0;
        [[maybe_unused]] const ssize_t closed = read(descriptor, &none, 1); // until the receiver is done
        _exit(0);
    }
    FrameSender(const FrameSender&) = delete;
    FrameSender& operator=(const FrameSender&) = delete;

    /// Waits for its end, which comes when the receiver closes. False when not everything was taken.
    bool succeeded() const
    {
        int status = 1;
        return child > 0 && waitpid(child, &status, 0) == child && status == 0;
    }

private:
    static void send(int descriptor, std::span<const std::byte> bytes)
    {
        while (!bytes.empty()) {
            const ssize_t count = write(descriptor, bytes.data(), bytes.size());
            if (count <= 0)
                _exit(1);
            bytes = bytes.subspan(static_cast<std::size_t>(count));
        }
    }

    pid_t child;
};

} // namespace pelorus::bench
