#include "telephonyd/server/TelephonyServer.h"

#include "platform/PropertyList.h"
#include "platform/linux/MainQueue.h"

#include <fmt/format.h>
#include <random>

namespace pelorus {

namespace {

using namespace std::chrono_literals;

constexpr const char* kServerPort = "io.pelorus.TelephonyServer";
constexpr std::int32_t kCreateLogChannel = 1; // message id
constexpr std::string_view kCreateLogChannelKey = "CreateLogChannel";
constexpr std::size_t kLongestRequest = 64 * 1024;
/// A live client's port takes a connection at once, or its backlog is full and it stalls.
constexpr auto kConnectTimeout = 100ms;

/// Of a port that no other channel, of this server or of one before it, goes by.
std::string commandPortName(unsigned number)
{
    return fmt::format("io.pelorus.LogChannel.{}.{:08x}", number, std::random_device()());
}

/// The name of the local port; empty when there is none.
std::string requestedPort(std::span<const std::byte> request)
{
    if (request.size() > kLongestRequest)
        return {};
    const Value command = parsePropertyList(request);
    const Value* name = command.dictionary() ? command.dictionary()->find(kCreateLogChannelKey) : nullptr;
    return name && name->string() ? *name->string() : std::string();
}

} // namespace

TelephonyServer::TelephonyServer(PortDirectory directory, Settings settings)
    : directory(std::move(directory)), settings(std::move(settings))
{}

TelephonyServer::~TelephonyServer()
{
    for (const auto& connection : connections)
        connection->close();
}

PortListener::Outcome TelephonyServer::listen(std::string& why)
{
    return listener.listen(directory, kServerPort, why);
}

PortListener::Outcome TelephonyServer::listenOn(FileDescriptor socket, std::string& why)
{
    return listener.adopt(std::move(socket), directory, kServerPort, why);
}

void TelephonyServer::acceptClients()
{
    listener.acceptConnections(
        [this](std::shared_ptr<PortConnection> connection) { take(std::move(connection)); });
}

void TelephonyServer::take(std::shared_ptr<PortConnection> connection)
{
    if (connections.size() == kMostConnections)
        return;
    connection->onClosed([this](PortConnection& closed) { connections.erase(closed.shared_from_this()); });
    connection->onFrame([this](PortConnection& from, const Frame& frame) { handle(from, frame); });
    connections.insert(std::move(connection));
}

void TelephonyServer::handle(PortConnection& connection, const Frame& frame)
{
    if (frame.kind != FrameKind::request)
        return;
    if (frame.id != kCreateLogChannel) {
        connection.reply(frame, std::nullopt);
        return;
    }
    std::string remotePort;
    std::string why;
    const Error error = createChannel(requestedPort(frame.payload), remotePort, why);
    const auto reply = makeDictionary({{"Error", static_cast<int>(error)}});
    if (error == none) {
        reply->set("RemotePort", remotePort);
        lastRefusal.clear();
    } else {
        reportRefusal(error, why);
    }
    connection.reply(frame, serializePropertyList(reply));
}

TelephonyServer::Error TelephonyServer::createChannel(const std::string& localPort, std::string& remotePort,
                                                      std::string& why)
{
    const auto path = directory.socketPath(localPort, why);
    if (!path)
        return unreachable;
    if (channels.size() == kMostChannels) {
        why = fmt::format("there are {} already", channels.size());
        return tooManyChannels;
    }
    auto source = settings.makeSource(why);
    if (!source)
        return noBaseband;
    auto client = PortConnection::connectTo(*path, why, kConnectTimeout);
    if (!client)
        return unreachable;
    const unsigned number = ++lastNumber;
    remotePort = commandPortName(number);
    auto commandPort = std::make_unique<PortListener>();
    if (commandPort->listen(directory, remotePort, why) != PortListener::Outcome::listening)
        return tooManyChannels; // for this system or this directory

    channels.emplace(number, std::make_shared<LogChannel>(LogChannel::Setup{
                                 .number = number,
                                 .technology = settings.technology,
                                 .client = std::move(client),
                                 .commandPort = std::move(commandPort),
                                 .stream = {std::move(source), settings.pace, settings.loop},
                                 .patience = settings.patience,
                                 .recorder = recorder,
                                 .report = settings.report,
                                 .ended = [this, number] { remove(number); },
                             }));
    settings.report(
        fmt::format("{}: channel {}: client connected, {}", settings.technology, number, localPort));
    return none;
}

void TelephonyServer::reportRefusal(Error error, const std::string& why)
{
    std::string line = fmt::format("no channel (error {}): {}", static_cast<int>(error), why);
    if (!settings.technology.empty())
        line = settings.technology + ": " + line;
    if (line != lastRefusal)
        settings.report(line);
    lastRefusal = std::move(line);
}

void TelephonyServer::changeTechnology(const std::string& technology)
{
    if (technology == settings.technology)
        return;
    const std::string before = std::exchange(settings.technology, technology);
    dropChannels(technology.empty()
                     ? "its baseband is gone"
                     : fmt::format("the technology is {} now, no longer {}", technology, before));
}

void TelephonyServer::dropChannels(const std::string& reason)
{
    const auto dropped = channels; // each removes itself
    for (const auto& [number, channel] : dropped)
        channel->drop(reason);
}

void TelephonyServer::remove(unsigned number)
{
    const auto found = channels.find(number);
    if (found == channels.end())
        return;
    // It is in the middle of one of its callbacks.
    postToMainQueue([channel = std::move(found->second)] {});
    channels.erase(found);
}

} // namespace pelorus
