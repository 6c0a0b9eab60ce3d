#pragma once

#include "LogGenerator/Osprey/LogPacket.h"

#include <cstddef>
#include <random>
#include <span>
#include <vector>

namespace pelorus::test {

/// Calls `receive(packet)` with every prefix of a packet, the empty one and the whole included, each in
/// memory of its own size, so that a sanitizer sees whatever is read beyond it.
template <class Receive> void forEachPrefix(std::span<const std::byte> packet, Receive receive)
{
    for (std::size_t length = 0; length <= packet.size(); ++length) {
        const std::vector<std::byte> prefix(packet.begin(),
                                            packet.begin() + static_cast<std::ptrdiff_t>(length));
        receive(LogPacket(prefix));
    }
}

/// Calls `receive(packet)` with `count` packets of random bytes and of random lengths up to `longest`: the
/// same ones in every run.
template <class Receive> void forRandomPackets(std::size_t count, std::size_t longest, Receive receive)
{
    std::mt19937 random(20120504); // NOLINT(cert-msc51-cpp): repeatable on purpose
    for (std::size_t packet = 0; packet < count; ++packet) {
        std::vector<std::byte> bytes(random() % (longest + 1));
        for (std::byte& byte : bytes)
            byte = static_cast<std::byte>(random());
        receive(LogPacket(bytes));
    }
}

} // namespace pelorus::test
