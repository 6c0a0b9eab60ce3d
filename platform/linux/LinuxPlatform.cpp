#include "platform/linux/LinuxPlatform.h"

#include "platform/PropertyList.h"
#include "platform/SystemLog.h"
#include "platform/linux/CallbackBoundary.h"
#include "platform/linux/Files.h"
#include "platform/linux/LinuxServerConnection.h"
#include "platform/linux/LinuxTimer.h"
#include "platform/linux/LocalPort.h"
#include "platform/linux/RemotePort.h"
#include "platform/linux/SnapshotDirectory.h"

#include <cstdio>
#include <ctime>
#include <filesystem>

namespace pelorus {

LinuxPlatform::LinuxPlatform(const std::string& resourceDirectory)
    : resources(resourceDirectory.empty() ? ResourceDirectory::besideThisProgram()
                                          : ResourceDirectory(resourceDirectory)),
      mainQueue(std::make_unique<QObject>())
{}

LinuxPlatform::~LinuxPlatform() = default;

Platform::LocalPort LinuxPlatform::createLocalMessagePort(const std::string& name,
                                                          PortMessageCallback callback)
{
    std::string why;
    const auto directory = openPortDirectory();
    if (!directory)
        return {};
    auto port = std::make_shared<pelorus::LocalPort>(std::move(callback));
    switch (port->listen(*directory, name, why)) {
    case PortListener::Outcome::listening:
        return {port, false};
    case PortListener::Outcome::alreadyExisted:
        return {port, true};
    case PortListener::Outcome::failed:
        break;
    }
    reportPortTrouble(why);
    return {};
}

void LinuxPlatform::deliverOnMainQueue(MessagePort& localPort)
{
    dynamic_cast<pelorus::LocalPort&>(localPort).startDelivery();
}

void LinuxPlatform::setInvalidationCallback(MessagePort& port, PortInvalidationCallback callback)
{
    dynamic_cast<LinuxMessagePort&>(port).setInvalidationCallback(std::move(callback));
}

std::shared_ptr<MessagePort> LinuxPlatform::createRemoteMessagePort(const std::string& name)
{
    const auto directory = openPortDirectory();
    std::string why;
    const auto path = directory ? directory->socketPath(name, why) : std::nullopt;
    return path ? RemotePort::connectTo(*path, why) : nullptr;
}

PortReply LinuxPlatform::sendPortRequest(MessagePort& remotePort, std::int32_t messageId,
                                         std::span<const std::byte> payload, Seconds sendTimeout,
                                         Seconds receiveTimeout)
{
    return dynamic_cast<RemotePort&>(remotePort).send(messageId, payload, sendTimeout, receiveTimeout);
}

bool LinuxPlatform::isPortValid(const MessagePort& port)
{
    return dynamic_cast<const LinuxMessagePort&>(port).isValid();
}

void LinuxPlatform::invalidatePort(MessagePort& port)
{
    dynamic_cast<LinuxMessagePort&>(port).invalidate();
}

std::shared_ptr<ServerConnection> LinuxPlatform::createServerConnection(std::function<void()> notification)
{
    const auto directory = openPortDirectory();
    std::string why;
    return directory ? LinuxServerConnection::open(*directory, std::move(notification), why) : nullptr;
}

Platform::LogChannel LinuxPlatform::createLogChannel(ServerConnection& connection,
                                                     const std::string& localPortName)
{
    return dynamic_cast<LinuxServerConnection&>(connection).createLogChannel(localPortName);
}

void LinuxPlatform::dispatchAsyncOnMain(std::function<void()> closure)
{
    QMetaObject::invokeMethod(
        mainQueue.get(), [closure = std::move(closure)] { callAtBoundary(closure); }, Qt::QueuedConnection);
}

void LinuxPlatform::dispatchAfterOnMain(std::chrono::nanoseconds delay, std::function<void()> closure)
{
    QTimer::singleShot(timerDuration(delay), Qt::PreciseTimer, mainQueue.get(),
                       [closure = std::move(closure)] { callAtBoundary(closure); });
}

std::unique_ptr<RepeatingTimer> LinuxPlatform::scheduleRepeatingTimer(Seconds interval,
                                                                      std::function<void()> tick)
{
    return std::make_unique<LinuxTimer>(*mainQueue, interval, std::move(tick));
}

std::optional<std::string> LinuxPlatform::findPropertyListResource(const std::string& name)
{
    return resources.find(name);
}

std::vector<std::string> LinuxPlatform::listPropertyListResources()
{
    return resources.list();
}

std::optional<std::string> LinuxPlatform::bundleVersion()
{
    return PELORUS_VERSION;
}

std::chrono::system_clock::time_point LinuxPlatform::now()
{
    return std::chrono::system_clock::now();
}

Platform::LocalZone LinuxPlatform::localZone()
{
    const std::time_t moment = std::time(nullptr);
    std::tm local = {};
    if (!::localtime_r(&moment, &local))
        return {};
    return {std::chrono::seconds(local.tm_gmtoff), local.tm_isdst > 0};
}

bool LinuxPlatform::fileExists(const std::string& path)
{
    std::error_code error;
    return std::filesystem::exists(path, error);
}

std::optional<Bytes> LinuxPlatform::readFile(const std::string& path)
{
    return readWholeFile(path);
}

bool LinuxPlatform::writePropertyList(const Value& value, const std::string& path)
{
    const auto bytes = serializePropertyList(value);
    return bytes && writeWholeFile(path, *bytes);
}

std::string LinuxPlatform::snapshotDirectory()
{
    return findSnapshotDirectory();
}

std::optional<PortDirectory> LinuxPlatform::openPortDirectory()
{
    std::string why;
    auto directory = PortDirectory::open(why);
    if (!directory)
        reportPortTrouble(why);
    return directory;
}

void LinuxPlatform::reportPortTrouble(const std::string& why)
{
    if (why != reportedTrouble)
        systemLog(kLogError, "%s", why);
    reportedTrouble = why;
}

} // namespace pelorus
