#include "model/PelorusModel.h"

#include "model/SnapshotFile.h"
#include "platform/PropertyList.h"
#include "platform/SystemLog.h"

namespace pelorus {

namespace {

const std::string kLocalPortName = "io.pelorus.BasebandStateReport.LogChannel";
constexpr Seconds kRefreshInterval{2.0};
constexpr Seconds kSendTimeout{1.0};
constexpr Seconds kReplyTimeout{1.0};
constexpr Seconds kNoReply{0.0};
constexpr std::chrono::nanoseconds kRetryDelay{5'000'000'000};
constexpr std::int32_t kLogMessage = 0;
constexpr std::int32_t kCommand = 0;

const void* address(const std::shared_ptr<MessagePort>& port)
{
    return port.get();
}

} // namespace

PelorusModel::PelorusModel(Platform& system, PelorusModelObserver& watcher)
    : platform(system), observer(watcher), self(std::make_shared<PelorusModel*>(this))
{}

PelorusModel::~PelorusModel()
{
    self.reset(); // before the ports go, so that nothing they set off comes back here
    destroyPorts();
}

bool PelorusModel::createPorts()
{
    const std::weak_ptr<PelorusModel*> model = self;
    auto local = platform.createLocalMessagePort(
        kLocalPortName, [model](std::int32_t id, std::span<const std::byte> data) -> std::optional<Bytes> {
            if (const auto alive = model.lock(); alive && id == kLogMessage)
                (*alive)->updateWithData(data);
            return std::nullopt;
        });
    recvPort = std::move(local.port);
    if (!recvPort) {
        systemLog(kLogError, "Could not create local message port");
        return false;
    }
    if (local.alreadyExisted) {
        systemLog(kLogError, "Local messsage port already exists"); // three s: meant
        return false;
    }
    platform.deliverOnMainQueue(*recvPort);
    platform.setInvalidationCallback(*recvPort, [model](MessagePort& port) {
        systemLog(kLogError, " ***** INVALIDATED %p *****", static_cast<const void*>(&port));
        if (const auto alive = model.lock())
            (*alive)->restartMonitor();
    });

    auto connection = platform.createServerConnection([model] {
        if (const auto alive = model.lock())
            (*alive)->refresh();
    });
    if (!connection) {
        systemLog(kLogError, "Could not create HXServerConnection");
        return false;
    }
    const Platform::LogChannel channel = platform.createLogChannel(*connection, kLocalPortName);
    connection.reset();
    if (channel.error != 0) {
        systemLog(kLogError, "_HXServerConnectionNetworkMonitorCreateLogChannel returns error: %ld!",
                  long{channel.error});
        return false;
    }
    if (channel.remotePort.empty()) {
        systemLog(kLogError, "Could not create a log channel (HX returned null port)!");
        return false;
    }
    sendPort = platform.createRemoteMessagePort(channel.remotePort);
    if (!sendPort) {
        systemLog(kLogError, "Could not create the remote port!");
        return false;
    }
    systemLog(kLogError, " ***** Created ports (send=%p, recv=%p)", address(sendPort), address(recvPort));
    return true;
}

void PelorusModel::configureGenerator()
{
    const auto command = serializePropertyList(makeDictionary({{"GetTechnology", "GetTechnology"}}));
    if (!command) {
        systemLog(kLogError, " Could not generate GetTechnology command; cannot configure");
        return;
    }
    const PortReply answer =
        platform.sendPortRequest(*sendPort, kCommand, *command, kSendTimeout, kReplyTimeout);
    if (answer.status != 0) {
        systemLog(kLogError, " ***** Could not send the GetTechnology command (got error=%d)", answer.status);
        return;
    }
    if (!answer.reply) {
        systemLog(kLogError, " ***** No response to GetTechnology; cannot configure");
        return;
    }
    const Value reply = parsePropertyList(*answer.reply);
    if (!reply.dictionary()) {
        systemLog(kLogError, " ***** Could not parse reply to GetTechnology; cannot configure");
        return;
    }
    const Value technology = reply.dictionary()->at("GetTechnology");
    if (!technology) {
        systemLog(kLogError, " ***** Reply to GetTechnology had no answer; cannot configure");
        return;
    }
    if (logGenerator && unrecorded)
        recordDisplay(); // its raw messages go with it, and no refresh came for them
    // Only an answer replaces the generator: after any earlier failure the one of the last success goes on.
    logGenerator =
        technology.string() ? LogGenerator::generatorFromTechnology(platform, *technology.string()) : nullptr;
    systemLog(kLogError, "Got log generated: %p", static_cast<const void*>(logGenerator.get()));
}

bool PelorusModel::sendStartCommand()
{
    const auto command = serializePropertyList(logGenerator->getStartCommand());
    if (!command) {
        systemLog(kLogError, " Could not generate PLIST");
        return false;
    }
    const PortReply sent = platform.sendPortRequest(*sendPort, kCommand, *command, kSendTimeout, kNoReply);
    if (sent.status != 0) {
        systemLog(kLogError, " ***** Could not send the START command (got error=%d)", sent.status);
        return false;
    }
    return true;
}

bool PelorusModel::openChannel()
{
    if (!createPorts()) {
        systemLog(kLogError, "Could not create the ports necessary");
        return false;
    }
    configureGenerator();
    if (!logGenerator) {
        systemLog(kLogError, "No log generator technology works");
        return false;
    }
    return sendStartCommand();
}

void PelorusModel::startMonitor()
{
    if (displayUpdateTimer)
        return;
    const std::weak_ptr<PelorusModel*> model = self;
    if (openChannel()) {
        systemLog(kLogError, "Starting the display update timer");
        displayUpdateTimer = platform.scheduleRepeatingTimer(kRefreshInterval, [model] {
            if (const auto alive = model.lock())
                (*alive)->refresh();
        });
        announceConnection();
        return;
    }
    destroyPorts();
    platform.dispatchAfterOnMain(kRetryDelay, [model] {
        if (const auto alive = model.lock())
            (*alive)->startMonitor();
    });
}

void PelorusModel::restartMonitor()
{
    destroyPorts();
    startMonitor();
}

void PelorusModel::destroyPorts()
{
    if (displayUpdateTimer) {
        displayUpdateTimer->invalidate();
        displayUpdateTimer.reset();
    }
    for (auto* field : {&recvPort, &sendPort}) {
        const std::shared_ptr<MessagePort> port = std::move(*field);
        if (!port)
            continue;
        platform.setInvalidationCallback(*port, nullptr); // or tearing down would restart the monitor
        platform.invalidatePort(*port);
    }
    announceConnection();
}

void PelorusModel::announceConnection()
{
    if (isConnected() == announcedConnection || !self)
        return;
    announcedConnection = isConnected();
    platform.dispatchAsyncOnMain([model = std::weak_ptr<PelorusModel*>(self)] {
        if (const auto alive = model.lock())
            (*alive)->observer.connectionChanged();
    });
}

void PelorusModel::updateWithData(std::span<const std::byte> data)
{
    unrecorded = true; // at once: the message that ends the program counts too
    lastMessage = platform.now();
    if (logGenerator)
        logGenerator->updateState(*state, data);
    updated = true;
}

void PelorusModel::refresh()
{
    if (recvPort && sendPort && !platform.isPortValid(*sendPort)) {
        const std::shared_ptr<MessagePort> port = recvPort; // its invalidation callback lets go of it
        platform.invalidatePort(*port);
    }
    if (!updated)
        return;
    updated = false;
    nodes.reset();
    nodesByPath.reset();
    platform.dispatchAsyncOnMain([model = std::weak_ptr<PelorusModel*>(self)] {
        if (const auto alive = model.lock())
            (*alive)->observer.updateViewControllerFromModel();
    });
}

std::shared_ptr<const PelorusModelNode> PelorusModel::topLevelNodes()
{
    if (nodes || !logGenerator)
        return nodes;
    const Value display = recordDisplay();
    nodesByPath = std::make_unique<PathDictionary>();
    nodes = PelorusModelNode::makeTreeFromObject(display, *nodesByPath);
    return nodes;
}

Value PelorusModel::recordDisplay()
{
    Value display = logGenerator->generateLogUsingState(*state);
    unrecorded = false;
    return display;
}

std::shared_ptr<const PelorusModelNode> PelorusModel::nodeAtPath(const std::string& path)
{
    if (!nodesByPath)
        topLevelNodes();
    if (!nodesByPath)
        return nullptr;
    const auto found = nodesByPath->find(path);
    return found == nodesByPath->end() ? nullptr : found->second;
}

std::shared_ptr<Array> PelorusModel::getSaveContents() const
{
    return logGenerator ? logGenerator->getSaveContentsFromState(*state) : nullptr;
}

std::optional<std::string> PelorusModel::writeRecoverySnapshot(std::string_view exceptionName,
                                                               std::string* why)
{
    if (logGenerator && unrecorded) {
        try {
            recordDisplay();
        } catch (const std::exception& exception) { // perhaps the one that ends the program, once more
            systemLog(kLogError, "The last messages are not in the recovered snapshot: %s",
                      std::string(exception.what()));
        }
    }
    std::shared_ptr<Array> contents = getSaveContents();
    if (!contents) {
        contents = makeArray();
        if (const Value history = state->at("History"); history.array())
            contents->elements = history.array()->elements;
    }
    return writeSnapshotFile(platform,
                             snapshotFileContent(dateText(platform.now()), contents,
                                                 "Recovered after " + std::string(exceptionName)),
                             why);
}

} // namespace pelorus
