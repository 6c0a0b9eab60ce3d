#include "telephonyd/server/LogChannel.h"

#include "platform/PropertyList.h"

#include <algorithm>
#include <fmt/format.h>

namespace pelorus {

namespace {

using namespace std::chrono_literals;

constexpr std::int32_t kCommand = 0; // message ids
constexpr std::int32_t kLogMessage = 0;
constexpr std::size_t kLongestCommand = 256 * 1024; // far above all log codes there are in XML
constexpr std::chrono::milliseconds kTick = 5ms;    // what is due in one goes out together
constexpr std::chrono::milliseconds kLongestWait = 1h;
constexpr std::size_t kRefillBelow = LogChannel::kMostUnsent / 2;
constexpr std::string_view kGetTechnology = "GetTechnology";

void refuseRequest(PortConnection& connection, const Frame& frame)
{
    if (frame.kind == FrameKind::request)
        connection.reply(frame, std::nullopt);
}

} // namespace

LogChannel::LogChannel(Setup parts) : setup(std::move(parts))
{
    setup.client->onFrame(refuseRequest); // nothing is expected there, but its end is to be seen
    setup.client->onClosed([this](PortConnection&) { end("client gone, the client's port is gone"); });
    setup.client->onDrained(
        [this](PortConnection&) {
            if (waitsForRoom)
                pump();
        },
        kRefillBelow);
    setup.commandPort->acceptConnections(
        [this](std::shared_ptr<PortConnection> connection) { takeCommandConnection(std::move(connection)); });

    patienceTimer.setSingleShot(true);
    QObject::connect(&patienceTimer, &QTimer::timeout, &patienceTimer,
                     [this] { end("client gone, the client did not connect to its command port"); });
    patienceTimer.start(setup.patience);
    pumpTimer.setSingleShot(true);
    pumpTimer.setTimerType(Qt::PreciseTimer);
    QObject::connect(&pumpTimer, &QTimer::timeout, &pumpTimer, [this] { pump(); });
    setup.stream.onMore([this] {
        if (sinceStart.isValid() && !hasEnded)
            pump();
    });
}

LogChannel::~LogChannel()
{
    close();
}

void LogChannel::say(const std::string& what) const
{
    setup.report(fmt::format("{}: channel {}: {}", setup.technology, setup.number, what));
}

void LogChannel::takeCommandConnection(std::shared_ptr<PortConnection> connection)
{
    if (commands || hasEnded)
        return; // the port is one client's; whoever else comes is hung up on
    patienceTimer.stop();
    commands = std::move(connection);
    commands->onClosed([this](PortConnection&) { end("client gone, the client closed its command port"); });
    commands->onFrame([this](PortConnection& from, const Frame& frame) { handle(from, frame); });
}

void LogChannel::handle(PortConnection& connection, const Frame& frame)
{
    if (frame.kind == FrameKind::reply)
        return; // to nothing that was asked
    const auto data = frame.id == kCommand ? answer(frame) : std::nullopt;
    if (frame.kind == FrameKind::request)
        connection.reply(frame, data);
}

std::optional<std::vector<std::byte>> LogChannel::answer(const Frame& frame)
{
    std::string why;
    if (frame.payload.size() > kLongestCommand) {
        say(fmt::format("ignored: a command of {} bytes", frame.payload.size()));
        return std::nullopt;
    }
    const Value command = parsePropertyList(frame.payload, &why);
    if (!command)
        say(fmt::format("ignored: a command that is no property list: {}", why));
    else if (command.dictionary() && command.dictionary()->find(kGetTechnology))
        return serializePropertyList(makeDictionary({{kGetTechnology, setup.technology}}));
    else
        start(command);
    return std::nullopt;
}

void LogChannel::start(const Value& command)
{
    std::string why;
    auto subscription = Subscription::fromStartCommand(command, why);
    if (!subscription) {
        say(fmt::format("ignored: {}", why));
        return;
    }
    if (setup.technology == "IFX") // its messages have no codes to choose from
        subscription = Subscription::toEverything();
    say(fmt::format("client streaming, {}", subscription->description()));
    setup.stream.subscribe(*subscription);
    atEnd = false;
    if (!sinceStart.isValid())
        sinceStart.start();
    pump();
}

void LogChannel::pump()
{
    waitsForRoom = false;
    const Pace::Time now = std::chrono::nanoseconds(sinceStart.nsecsElapsed());
    const MessageStream::Pause pause = setup.stream.run(now, *this);
    switch (pause.wait) {
    case MessageStream::Wait::untilDue:
        pumpTimer.start(
            std::clamp(std::chrono::ceil<std::chrono::milliseconds>(pause.due - now), kTick, kLongestWait));
        break;
    case MessageStream::Wait::forRoom:
        waitsForRoom = true;
        break;
    case MessageStream::Wait::forTurn:
        pumpTimer.start(0ms);
        break;
    case MessageStream::Wait::forMore:
        break;
    case MessageStream::Wait::atEnd:
        if (!atEnd)
            say("that was the last message");
        atEnd = true;
        break;
    }
}

bool LogChannel::hasRoom(std::size_t length) const
{
    const std::size_t unsent = setup.client->unsent();
    return unsent == 0 || unsent + FrameHeader::size + length <= kMostUnsent;
}

void LogChannel::send(std::span<const std::byte> message)
{
    if (setup.client->send({.id = kLogMessage, .payload = message}) && setup.recorder)
        setup.recorder->record(message);
}

void LogChannel::drop(const std::string& reason)
{
    end("dropped, " + reason);
}

void LogChannel::end(const std::string& how)
{
    if (hasEnded)
        return;
    hasEnded = true;
    say(how);
    close();
    setup.ended();
}

void LogChannel::close()
{
    patienceTimer.stop();
    pumpTimer.stop();
    setup.client->close();
    if (commands)
        commands->close();
    setup.commandPort->close();
}

} // namespace pelorus
