#pragma once

#include "platform/linux/FileDescriptor.h"

#include <cstdint>
#include <span>
#include <string>
#include <vector>

namespace pelorus::fuzz {

/// A client's end of a connection, without any of the code under test. No call blocks; a connection that
/// cannot be made or is closed swallows what is sent.
class ClientConnection {
public:
    explicit ClientConnection(const std::string& path);

    void send(std::span<const std::byte> bytes) const;
    void sendHeader(std::uint32_t length, std::int32_t id, std::uint32_t kind) const;
    void sendFrame(std::int32_t id, std::uint32_t kind, std::span<const std::byte> payload) const;
    void halfClose() const;
    /// What has arrived by now.
    std::vector<std::byte> received() const;

private:
    FileDescriptor socket;
};

/// The name of the remote port that a server's reply gives; empty when it gives none.
std::string channelIn(std::span<const std::byte> reply);

} // namespace pelorus::fuzz
