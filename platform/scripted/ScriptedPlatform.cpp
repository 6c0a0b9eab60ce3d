#include "platform/scripted/ScriptedPlatform.h"

#include "platform/PropertyList.h"

#include <algorithm>
#include <deque>
#include <filesystem>
#include <fmt/format.h>
#include <fstream>
#include <iterator>
#include <utility>

namespace pelorus {

namespace {

Bytes toBytes(std::string_view text)
{
    const auto bytes = std::as_bytes(std::span(text));
    return {bytes.begin(), bytes.end()};
}

ScriptedPort& scripted(MessagePort& port)
{
    return dynamic_cast<ScriptedPort&>(port);
}

constexpr std::string_view kResourceDirectory = "/resources/";
constexpr std::string_view kExtension = ".plist";

} // namespace

/// What waits to run: the queue, and what is due at a moment of the virtual clock.
struct ScriptedPlatform::Schedule {
    struct Entry {
        std::function<void()> closure;
        Timer* timer; // null for a delayed closure
    };
    std::deque<std::function<void()>> queue;
    std::multimap<std::chrono::nanoseconds, Entry> due; // equal times in the order of their making
};

class ScriptedPlatform::Timer : public RepeatingTimer {
public:
    Timer(std::shared_ptr<Schedule> schedule, std::chrono::nanoseconds now, std::chrono::nanoseconds interval,
          std::function<void()> tick)
        : interval(interval), tick(std::move(tick)), schedule(std::move(schedule))
    {
        arm(now + interval);
    }
    /// The tick that follows one of `last`; those that a blocked thread missed are not made up for.
    void armAfter(std::chrono::nanoseconds last, std::chrono::nanoseconds now)
    {
        arm(last + interval * ((now - last) / interval + 1));
    }
    ~Timer() override { invalidate(); }
    void invalidate() override
    {
        std::erase_if(schedule->due, [this](const auto& item) { return item.second.timer == this; });
    }

private:
    void arm(std::chrono::nanoseconds when) { schedule->due.insert({when, {tick, this}}); }

    const std::chrono::nanoseconds interval;
    std::function<void()> tick;
    std::shared_ptr<Schedule> schedule;
};

class ScriptedPlatform::Connection : public ServerConnection {
public:
    Connection(std::shared_ptr<std::vector<Connection*>> all, std::function<void()> notification)
        : notification(std::move(notification)), all(std::move(all))
    {
        this->all->push_back(this);
    }
    ~Connection() override { std::erase(*all, this); }

    std::function<void()> notification;

private:
    std::shared_ptr<std::vector<Connection*>> all;
};

Value SentMessage::propertyList() const
{
    return parsePropertyList(payload);
}

ScriptedPlatform::ScriptedPlatform()
    : schedule(std::make_shared<Schedule>()), connections(std::make_shared<std::vector<Connection*>>())
{}

ScriptedPlatform::~ScriptedPlatform()
{
    // What a closure holds may schedule or cancel on its way out.
    auto queue = std::move(schedule->queue);
    auto due = std::move(schedule->due);
    schedule->queue.clear();
    schedule->due.clear();
}

void ScriptedPlatform::answerTechnology(std::string_view technology)
{
    requestAnswer = {0, serializePropertyList(makeDictionary({{"GetTechnology", technology}}))};
}

void ScriptedPlatform::answerWith(std::string_view bytes)
{
    requestAnswer = {0, toBytes(bytes)};
}

void ScriptedPlatform::addFile(const std::string& path, std::string_view content)
{
    files[path] = toBytes(content);
}

void ScriptedPlatform::addResource(const std::string& name, std::string_view propertyList)
{
    addFile(fmt::format("{}{}{}", kResourceDirectory, name, kExtension), propertyList);
}

void ScriptedPlatform::advance(std::chrono::nanoseconds duration)
{
    const auto target = elapsed + duration;
    runMainQueue();
    while (!schedule->due.empty() && schedule->due.begin()->first <= target) {
        auto next = schedule->due.extract(schedule->due.begin());
        const auto& [closure, timer] = next.mapped();
        elapsed = std::max(elapsed, next.key()); // a send that blocked may have moved the clock past it
        if (timer)
            timer->armAfter(next.key(), elapsed);
        closure();
        runMainQueue();
    }
    elapsed = std::max(elapsed, target);
}

void ScriptedPlatform::runMainQueue()
{
    while (!schedule->queue.empty()) {
        const auto closure = std::move(schedule->queue.front());
        schedule->queue.pop_front();
        closure();
    }
}

bool ScriptedPlatform::deliver(std::span<const std::byte> payload, std::int32_t id)
{
    const auto port = lastLocalPort.lock();
    if (!port || !port->valid || !port->delivering)
        return false;
    const auto callback = port->message; // it may invalidate the port
    lastReply = callback(id, payload);
    return true;
}

bool ScriptedPlatform::deliver(std::string_view payload, std::int32_t id)
{
    return deliver(std::as_bytes(std::span(payload)), id);
}

void ScriptedPlatform::breakPort(ScriptedPort& port)
{
    if (!std::exchange(port.valid, false))
        return;
    if (const auto callback = std::exchange(port.invalidation, nullptr))
        callback(port);
}

int ScriptedPlatform::notifyFromServer()
{
    const auto present = *connections;
    for (auto* connection : present)
        connection->notification();
    return static_cast<int>(present.size());
}

std::size_t ScriptedPlatform::repeatingTimers() const
{
    return static_cast<std::size_t>(
        std::ranges::count_if(schedule->due, [](const auto& item) { return item.second.timer != nullptr; }));
}

std::size_t ScriptedPlatform::waitingClosures() const
{
    return schedule->queue.size() + schedule->due.size() - repeatingTimers();
}

Platform::LocalPort ScriptedPlatform::createLocalMessagePort(const std::string& name,
                                                             PortMessageCallback callback)
{
    calls.push_back("createLocalMessagePort " + name);
    if (localPortFails)
        return {};
    auto port = std::make_shared<ScriptedPort>();
    port->name = name;
    port->local = true;
    if (!localPortExisted)
        port->message = std::move(callback);
    lastLocalPort = port;
    return {port, localPortExisted};
}

void ScriptedPlatform::deliverOnMainQueue(MessagePort& localPort)
{
    auto& port = scripted(localPort);
    calls.push_back("deliverOnMainQueue " + port.name);
    port.delivering = port.message != nullptr;
}

void ScriptedPlatform::setInvalidationCallback(MessagePort& port, PortInvalidationCallback callback)
{
    calls.push_back((callback ? "setInvalidationCallback " : "clearInvalidationCallback ") +
                    scripted(port).name);
    scripted(port).invalidation = std::move(callback);
}

std::shared_ptr<MessagePort> ScriptedPlatform::createRemoteMessagePort(const std::string& name)
{
    calls.push_back("createRemoteMessagePort " + name);
    if (remotePortFails)
        return nullptr;
    auto port = std::make_shared<ScriptedPort>();
    port->name = name;
    lastRemotePort = port;
    return port;
}

PortReply ScriptedPlatform::sendPortRequest(MessagePort& remotePort, std::int32_t messageId,
                                            std::span<const std::byte> payload, Seconds sendTimeout,
                                            Seconds receiveTimeout)
{
    const auto& port = scripted(remotePort);
    calls.push_back("sendPortRequest " + port.name);
    if (!port.valid)
        return {-3, std::nullopt};
    sent.push_back(
        {port.name, messageId, {payload.begin(), payload.end()}, sendTimeout, receiveTimeout, elapsed});
    elapsed += sendDuration;
    return receiveTimeout > Seconds(0) ? requestAnswer : PortReply{oneWayStatus, std::nullopt};
}

bool ScriptedPlatform::isPortValid(const MessagePort& port)
{
    return dynamic_cast<const ScriptedPort&>(port).valid;
}

void ScriptedPlatform::invalidatePort(MessagePort& port)
{
    calls.push_back("invalidatePort " + scripted(port).name);
    breakPort(scripted(port));
}

std::shared_ptr<ServerConnection> ScriptedPlatform::createServerConnection(std::function<void()> notification)
{
    calls.emplace_back("createServerConnection");
    return serverPresent ? std::make_shared<Connection>(connections, std::move(notification)) : nullptr;
}

Platform::LogChannel ScriptedPlatform::createLogChannel(ServerConnection&, const std::string& localPortName)
{
    calls.push_back("createLogChannel " + localPortName);
    if (duringLogChannel)
        duringLogChannel();
    return {logChannelError, logChannelError == 0 ? remotePortName : std::string()};
}

void ScriptedPlatform::dispatchAsyncOnMain(std::function<void()> closure)
{
    schedule->queue.push_back(std::move(closure));
}

void ScriptedPlatform::dispatchAfterOnMain(std::chrono::nanoseconds delay, std::function<void()> closure)
{
    schedule->due.insert({elapsed + delay, {std::move(closure), nullptr}});
}

std::unique_ptr<RepeatingTimer> ScriptedPlatform::scheduleRepeatingTimer(Seconds interval,
                                                                         std::function<void()> tick)
{
    return std::make_unique<Timer>(schedule, elapsed, std::chrono::round<std::chrono::nanoseconds>(interval),
                                   std::move(tick));
}

bool ScriptedPlatform::isDiskResource(const std::string& path) const
{
    return diskResources && path.starts_with(*diskResources + "/");
}

std::optional<std::string> ScriptedPlatform::findPropertyListResource(const std::string& name)
{
    if (name.find('/') != std::string::npos)
        return std::nullopt;
    auto added = fmt::format("{}{}{}", kResourceDirectory, name, kExtension);
    if (files.contains(added))
        return added;
    if (auto onDisk = fmt::format("{}/{}{}", diskResources.value_or(""), name, kExtension);
        fileExists(onDisk))
        return onDisk;
    return std::nullopt;
}

std::vector<std::string> ScriptedPlatform::listPropertyListResources()
{
    std::vector<std::string> paths;
    for (const auto& [path, content] : files)
        if (path.starts_with(kResourceDirectory) && path.ends_with(kExtension))
            paths.push_back(path);
    if (diskResources)
        for (const auto& entry : std::filesystem::directory_iterator(*diskResources))
            if (entry.path().extension() == kExtension)
                paths.push_back(entry.path());
    std::ranges::sort(paths);
    return paths;
}

std::chrono::system_clock::time_point ScriptedPlatform::now()
{
    return wallClockStart + elapsed;
}

bool ScriptedPlatform::fileExists(const std::string& path)
{
    return files.contains(path) || (isDiskResource(path) && std::filesystem::exists(path));
}

std::optional<Bytes> ScriptedPlatform::readFile(const std::string& path)
{
    if (const auto found = files.find(path); found != files.end())
        return found->second;
    if (!fileExists(path))
        return std::nullopt;
    std::ifstream file(path, std::ifstream::binary);
    return toBytes(std::string(std::istreambuf_iterator<char>(file), {}));
}

bool ScriptedPlatform::writePropertyList(const Value& value, const std::string& path)
{
    if (writesFail)
        return false;
    written[path] = deepCopy(value);
    return true;
}

} // namespace pelorus
