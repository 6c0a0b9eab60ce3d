// A telephony server and clients that do as they please: frames and no frames on the server's port and on the
// command ports of its channels, in any order. Whatever came, the server gives the next client its channel,
// and nothing is left of those that are gone.
//
// The input: operations, each a byte, most followed by a byte that chooses a connection and by a payload.

#include "telephonyd/server/TelephonyServer.h"
#include "fuzz/ClientConnection.h"
#include "fuzz/Input.h"
#include "fuzz/Require.h"
#include "platform/PrintableText.h"
#include "platform/PropertyList.h"

#include <QCoreApplication>
#include <QTemporaryDir>

using namespace pelorus;
using namespace pelorus::fuzz;

namespace {

constexpr int kMostOperations = 48;
constexpr std::size_t kMostConnections = 8;
constexpr std::size_t kLongestPayload = 4096;
constexpr std::string_view kClientPort = "client"; // where the well-behaved listen
enum Operation : unsigned {
    connectToServer,
    sendBytes,
    sendFrame,
    sendAnnouncement, // of a frame that does not come
    askForChannel,
    askForChannelOf, // any port
    connectToChannel,
    askForTechnology,
    startStreaming,
    halfClose,
    closeConnection,
    readConnection,
    runEventLoop,
    kOperations
};

QTemporaryDir& ports()
{
    static QTemporaryDir directory;
    return directory;
}

std::vector<std::byte> listWith(std::string_view key, const Value& value)
{
    return serializePropertyList(makeDictionary({{key, value}})).value();
}

std::vector<std::byte> startCommand()
{
    return serializePropertyList(
               makeDictionary({{"SetState", "Streaming"}, {"SetOspreyLogCodes", makeArray({0xB179})}}))
        .value();
}

/// Some messages of a code that is asked for and of one that is not.
class FewMessages : public MessageSource {
public:
    bool next(SourceMessage& message) override
    {
        if (count == kMessages)
            return false;
        packet[3] = count++ % 2 ? std::byte{0x79} : std::byte{0x80};
        message = {std::chrono::nanoseconds(count), packet};
        return true;
    }
    bool rewind() override
    {
        count = 0;
        return true;
    }

private:
    static constexpr int kMessages = 20;
    int count = 0;
    std::vector<std::byte> packet = [] {
        std::vector<std::byte> bytes(100);
        bytes[0] = std::byte{1};
        bytes[1] = std::byte{99};
        bytes[4] = std::byte{0xB1};
        return bytes;
    }();
};

class Scene {
public:
    Scene() : server(directory(), settings())
    {
        std::string why;
        require(server.listen(why) == PortListener::Outcome::listening, "the server listens");
        require(clientPort.listen(directory(), std::string(kClientPort), why) ==
                    PortListener::Outcome::listening,
                "a client listens");
        server.acceptClients();
        clientPort.acceptConnections([this](std::shared_ptr<PortConnection> connection) {
            connection->onFrame([](PortConnection&, const Frame&) {});
            streams.push_back(std::move(connection));
        });
    }

    void act(unsigned operation, Input& input);
    void checkThatItServes();

private:
    static PortDirectory directory()
    {
        std::string why;
        return PortDirectory::open(ports().path().toStdString(), why).value();
    }
    static TelephonyServer::Settings settings()
    {
        TelephonyServer::Settings made;
        made.technology = "Osprey LTE";
        made.makeSource = [](std::string&) { return std::make_unique<FewMessages>(); };
        made.pace = Pace::ownTiming(0);
        made.report = [](const std::string& line) {
            require(printable(line).find('\n') == std::string::npos, "a report is one line");
        };
        return made;
    }
    static std::vector<std::byte> payload(Input& input)
    {
        return input.copy(std::min(input.word(), kLongestPayload));
    }

    void connectTo(const std::string& name);
    /// Lets the server do what it can.
    static void run();

    TelephonyServer server;
    PortListener clientPort;
    std::vector<std::shared_ptr<PortConnection>> streams;
    std::vector<std::unique_ptr<ClientConnection>> connections;
    std::string lastChannel;
};

void Scene::run()
{
    // What one turn sends, the next one receives.
    for (int turn = 0; turn < 8; ++turn)
        QCoreApplication::processEvents();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
}

void Scene::connectTo(const std::string& name)
{
    if (connections.size() == kMostConnections)
        connections.erase(connections.begin());
    connections.push_back(std::make_unique<ClientConnection>(ports().path().toStdString() + '/' + name));
}

void Scene::act(unsigned operation, Input& input)
{
    if (operation == connectToServer)
        return connectTo("io.pelorus.TelephonyServer");
    if (operation == connectToChannel)
        return connectTo(lastChannel);
    if (operation == runEventLoop)
        return run();
    const unsigned choice = input.byte();
    if (connections.empty())
        connectTo("io.pelorus.TelephonyServer");
    ClientConnection& connection = *connections[choice % connections.size()];
    switch (operation) {
    case sendBytes:
        connection.send(payload(input));
        break;
    case sendFrame: {
        const auto id = static_cast<std::int32_t>(input.byte()) - 1;
        const unsigned kind = input.byte() % 4;
        connection.sendFrame(id, kind, payload(input));
        break;
    }
    case sendAnnouncement:
        connection.sendHeader(static_cast<std::uint32_t>(input.word() << 16 | input.word()), 1, 1);
        break;
    case askForChannel:
        connection.sendFrame(1, 1, listWith("CreateLogChannel", kClientPort));
        break;
    case askForChannelOf: {
        const auto name = payload(input);
        connection.sendFrame(1, 1,
                             listWith("CreateLogChannel",
                                      std::string(reinterpret_cast<const char*>(name.data()), name.size())));
        break;
    }
    case askForTechnology:
        connection.sendFrame(0, 1, listWith("GetTechnology", ""));
        break;
    case startStreaming:
        connection.sendFrame(0, 0, startCommand());
        break;
    case halfClose:
        connection.halfClose();
        break;
    case closeConnection:
        connections.erase(connections.begin() + static_cast<std::ptrdiff_t>(choice % connections.size()));
        break;
    case readConnection:
        if (const std::string name = channelIn(connection.received()); !name.empty())
            lastChannel = name;
        break;
    default:
        break;
    }
}

void Scene::checkThatItServes()
{
    connections.clear();
    for (int turn = 0; turn == 0 || (turn < 100 && server.channelCount() > 0); ++turn) {
        run(); // requests that lie there may still open channels
        for (const auto& stream : streams)
            stream->close();
        streams.clear();
    }
    require(server.channelCount() == 0, "a channel ends with its client");

    connectTo("io.pelorus.TelephonyServer");
    connections.back()->sendFrame(1, 1, listWith("CreateLogChannel", kClientPort));
    std::vector<std::byte> received;
    for (int turn = 0; turn < 100 && received.empty(); ++turn) {
        run();
        received = connections.back()->received();
    }
    require(!channelIn(received).empty(), "the next client gets its channel");
}

} // namespace

extern "C" int LLVMFuzzerInitialize(int* argumentCount, char*** arguments)
{
    static const QCoreApplication application(*argumentCount, *arguments);
    require(ports().isValid(), "there is a port directory");
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    Input input(data, size);
    Scene scene;
    for (int count = 0; !input.empty() && count < kMostOperations; ++count)
        scene.act(input.byte() % kOperations, input);
    scene.checkThatItServes();
    return 0;
}
