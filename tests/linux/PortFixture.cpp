#include "tests/linux/PortFixture.h"

#include <cstring>
#include <sys/socket.h>
#include <sys/time.h>
#include <sys/un.h>

namespace pelorus::test {

namespace {

sockaddr_un addressOf(const std::string& path)
{
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    EXPECT_LT(path.size(), sizeof address.sun_path);
    std::memcpy(address.sun_path, path.data(), path.size());
    return address;
}

} // namespace

EnvironmentVariable::EnvironmentVariable(std::string variable, const char* value)
    : name(std::move(variable)), had(std::getenv(name.c_str())), before(had ? std::getenv(name.c_str()) : "")
{
    set(value);
}

std::string wireFrame(std::uint32_t length, std::int32_t id, std::uint32_t kind, std::uint32_t sequence,
                      std::string_view payload)
{
    std::string bytes;
    for (const std::uint32_t field : {length, static_cast<std::uint32_t>(id), kind, sequence})
        for (int shift = 0; shift < 32; shift += 8)
            bytes.push_back(static_cast<char>(field >> shift & 0xFF));
    return bytes.append(payload);
}

std::string oneWay(std::string_view payload, std::int32_t id)
{
    return wireFrame(static_cast<std::uint32_t>(payload.size()), id, 0, 0, payload);
}

RawPeer::RawPeer(int descriptor) : socket(descriptor)
{
    const timeval limit = {30, 0}; // a test that fails must not hang
    ::setsockopt(descriptor, SOL_SOCKET, SO_RCVTIMEO, &limit, sizeof limit);
}

RawPeer RawPeer::connectTo(const std::string& path)
{
    RawPeer peer(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
    const sockaddr_un address = addressOf(path);
    if (::connect(peer.descriptor(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0)
        peer.close();
    return peer;
}

bool RawPeer::send(std::string_view bytes) const
{
    while (!bytes.empty()) {
        const auto count = ::send(socket.get(), bytes.data(), bytes.size(), MSG_NOSIGNAL);
        if (count < 0)
            return false;
        bytes.remove_prefix(static_cast<std::size_t>(count));
    }
    return true;
}

std::string RawPeer::receive(std::size_t length) const
{
    std::string bytes;
    char chunk[4096];
    while (bytes.size() < length) {
        const auto count = ::recv(socket.get(), chunk, std::min(sizeof chunk, length - bytes.size()), 0);
        if (count <= 0)
            break;
        bytes.append(chunk, static_cast<std::size_t>(count));
    }
    return bytes;
}

RawServer::RawServer(const std::string& path, std::function<void(RawPeer&)> serve)
    : listening(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0))
{
    const sockaddr_un address = addressOf(path);
    EXPECT_EQ(::bind(listening.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address), 0);
    EXPECT_EQ(::listen(listening.get(), 8), 0);
    thread = std::thread([this, serve = std::move(serve)] {
        RawPeer peer(::accept(listening.get(), nullptr, nullptr));
        if (peer.isConnected())
            serve(peer);
    });
}

RawServer::~RawServer()
{
    ::shutdown(listening.get(), SHUT_RDWR); // if nobody came
    thread.join();
}

} // namespace pelorus::test
