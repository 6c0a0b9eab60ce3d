#pragma once

#include "bench/FrameSender.h"

#include <benchmark/benchmark.h>
#include <cstring>

namespace pelorus::bench {

/// The least that receiving frames takes: read(2) into one buffer, and a walk from header to header.
class RawReceiver {
public:
    explicit RawReceiver(std::string socketPath) : path(std::move(socketPath))
    {
        const sockaddr_un address = addressOf(path);
        listener = socket(AF_UNIX, SOCK_STREAM, 0);
        if (bind(listener, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0 ||
            listen(listener, 1) != 0)
            throw std::runtime_error("cannot listen at " + path);
    }
    ~RawReceiver()
    {
        close(listener);
        unlink(path.c_str());
    }
    RawReceiver(const RawReceiver&) = delete;
    RawReceiver& operator=(const RawReceiver&) = delete;

    /// Takes so many frames from the next peer; how many came before it closed.
    std::size_t receive(std::size_t count)
    {
        const int peer = accept(listener, nullptr, nullptr);
        std::size_t frames = 0;
        std::size_t held = 0; // of the buffer, behind what is cut already
        while (frames < count) {
            const ssize_t got = read(peer, buffer.data() + held, buffer.size() - held);
            if (got <= 0)
                break;
            const std::size_t end = held + static_cast<std::size_t>(got);
            std::size_t place = 0;
            for (std::size_t length = 0; (length = frameAt(place, end)) != 0; place += length) {
                ++frames;
                benchmark::DoNotOptimize(buffer.data() + place);
            }
            held = end - place;
            std::memmove(buffer.data(), buffer.data() + place, held);
        }
        close(peer);
        return frames;
    }

private:
    /// 0 unless a whole frame is there.
    std::size_t frameAt(std::size_t place, std::size_t end) const
    {
        std::uint32_t payload = 0;
        if (end - place < FrameHeader::size)
            return 0;
        std::memcpy(&payload, buffer.data() + place, sizeof payload);
        return end - place - FrameHeader::size < payload ? 0 : FrameHeader::size + payload;
    }

    std::string path;
    int listener = -1;
    std::vector<std::byte> buffer = std::vector<std::byte>(64 * 1024);
};

} // namespace pelorus::bench
