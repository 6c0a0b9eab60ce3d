#include "fuzz/ClientConnection.h"

#include "platform/PropertyList.h"

#include <cstring>
#include <sys/socket.h>
#include <sys/un.h>

namespace pelorus::fuzz {

ClientConnection::ClientConnection(const std::string& path)
    : socket(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0))
{
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    std::memcpy(address.sun_path, path.data(), std::min(path.size(), sizeof address.sun_path - 1));
    if (::connect(socket.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0)
        socket = FileDescriptor();
}

void ClientConnection::send(std::span<const std::byte> bytes) const
{
    ::send(socket.get(), bytes.data(), bytes.size(), MSG_NOSIGNAL);
}

void ClientConnection::sendHeader(std::uint32_t length, std::int32_t id, std::uint32_t kind) const
{
    std::vector<std::byte> header;
    for (const std::uint32_t field : {length, static_cast<std::uint32_t>(id), kind, std::uint32_t{7}})
        for (int shift = 0; shift < 32; shift += 8)
            header.push_back(static_cast<std::byte>(field >> shift));
    send(header);
}

void ClientConnection::sendFrame(std::int32_t id, std::uint32_t kind,
                                 std::span<const std::byte> payload) const
{
    sendHeader(static_cast<std::uint32_t>(payload.size()), id, kind);
    send(payload);
}

void ClientConnection::halfClose() const
{
    ::shutdown(socket.get(), SHUT_WR);
}

std::vector<std::byte> ClientConnection::received() const
{
    std::vector<std::byte> bytes(65536);
    const auto count = ::recv(socket.get(), bytes.data(), bytes.size(), 0);
    bytes.resize(count > 0 ? static_cast<std::size_t>(count) : 0);
    return bytes;
}

std::string channelIn(std::span<const std::byte> reply)
{
    constexpr std::size_t kHeader = 16;
    if (reply.size() <= kHeader)
        return {};
    const Value list = parsePropertyList(reply.subspan(kHeader));
    const Value name = list.dictionary() ? list.dictionary()->at("RemotePort") : Value();
    return name.string() ? *name.string() : std::string();
}

} // namespace pelorus::fuzz
