#include "platform/linux/LinuxServerConnection.h"

#include "platform/PropertyList.h"
#include "platform/linux/MainQueue.h"

#include <limits>

namespace pelorus {

namespace {

constexpr const char* kServerPort = "io.pelorus.TelephonyServer";
constexpr std::int32_t kCreateLogChannel = 1; // message ids on a server connection
constexpr std::int32_t kNotification = 2;
constexpr std::int32_t kSenselessReply = -4;
constexpr Seconds kTimeout{1};

Platform::LogChannel readReply(std::span<const std::byte> bytes)
{
    const Value reply = parsePropertyList(bytes);
    const Dictionary* entries = reply.dictionary();
    const Value error = entries ? entries->at("Error") : Value();
    using Limits = std::numeric_limits<std::int32_t>;
    if (!error.integer() || *error.integer() < Limits::min() || *error.integer() > Limits::max())
        return {kSenselessReply, {}};
    const Value remotePort = entries->at("RemotePort");
    return {static_cast<std::int32_t>(*error.integer()),
            remotePort.string() ? *remotePort.string() : std::string()};
}

} // namespace

std::shared_ptr<LinuxServerConnection> LinuxServerConnection::open(const PortDirectory& directory,
                                                                   std::function<void()> notification,
                                                                   std::string& why)
{
    const auto path = directory.socketPath(kServerPort, why);
    auto connection = path ? PortConnection::connectTo(*path, why) : nullptr;
    if (!connection)
        return nullptr;
    return std::shared_ptr<LinuxServerConnection>(
        new LinuxServerConnection(std::move(connection), std::move(notification)));
}

LinuxServerConnection::LinuxServerConnection(std::shared_ptr<PortConnection> established,
                                             std::function<void()> notification)
    : connection(std::move(established)), sender(*connection),
      notification(std::make_shared<std::function<void()>>(std::move(notification)))
{
    connection->onFrame([this](PortConnection&, const Frame& frame) { handle(frame); });
}

LinuxServerConnection::~LinuxServerConnection()
{
    connection->close();
}

Platform::LogChannel LinuxServerConnection::createLogChannel(const std::string& localPortName)
{
    const auto request = serializePropertyList(makeDictionary({{"CreateLogChannel", localPortName}}));
    if (!request)
        return {kSenselessReply, {}};
    const PortReply answer = sender.send(kCreateLogChannel, *request, kTimeout, kTimeout);
    if (answer.status != 0)
        return {answer.status, {}};
    return answer.reply ? readReply(*answer.reply) : Platform::LogChannel{kSenselessReply, {}};
}

void LinuxServerConnection::handle(const Frame& frame)
{
    sender.takeReply(frame);
    if (frame.kind != FrameKind::oneWay || frame.id != kNotification || !*notification)
        return;
    postToMainQueue([wanted = std::weak_ptr(notification)] {
        if (const auto callback = wanted.lock())
            (*callback)();
    });
}

} // namespace pelorus
