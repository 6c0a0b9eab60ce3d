#include "tests/telephonyd/TestClient.h"

#include "tests/linux/EventLoop.h"

#include <fmt/format.h>
#include <gtest/gtest.h>

namespace pelorus::test {

namespace {

std::shared_ptr<PortConnection> connectTo(const std::string& name)
{
    std::string why;
    const auto directory = PortDirectory::open(why);
    auto connection = PortConnection::connectTo(*directory->socketPath(name, why), why);
    EXPECT_TRUE(connection) << why;
    return connection;
}

} // namespace

Value startCommand(std::vector<int> basebandCodes, std::vector<int> serverCodes)
{
    return makeDictionary({{"SetState", "Streaming"},
                           {"SetOspreyLogCodes", makeArray({basebandCodes.begin(), basebandCodes.end()})},
                           {"SetCtExtraCodes", makeArray({serverCodes.begin(), serverCodes.end()})}});
}

std::string codeOf(const std::vector<std::byte>& message)
{
    return fmt::format("{:02X}:{:02X}{:02X}", std::to_integer<int>(message.at(0)),
                       std::to_integer<int>(message.at(4)), std::to_integer<int>(message.at(3)));
}

TestClient::TestClient(std::string portName, bool reads) : name(std::move(portName))
{
    std::string why;
    const auto directory = PortDirectory::open(why);
    EXPECT_TRUE(directory) << why;
    EXPECT_EQ(listener.listen(*directory, name, why), PortListener::Outcome::listening) << why;
    listener.acceptConnections([this, reads](std::shared_ptr<PortConnection> connection) {
        if (port)
            earlierPorts.push_back(std::move(port));
        port = std::move(connection);
        if (!reads)
            return;
        port->onClosed([this](PortConnection&) { portClosed = true; });
        port->onFrame([this](PortConnection&, const Frame& frame) {
            EXPECT_EQ(frame.id, 0);
            EXPECT_EQ(frame.kind, FrameKind::oneWay);
            messages.emplace_back(frame.payload.begin(), frame.payload.end());
        });
    });
}

std::optional<Value> TestClient::request(PortConnection& connection, std::int32_t id, const Value& payload)
{
    std::optional<Value> reply;
    bool replied = false;
    const std::uint32_t expected = ++sequence;
    const auto bytes = serializePropertyList(payload);
    connection.onFrame([&](PortConnection&, const Frame& frame) {
        EXPECT_EQ(frame.kind, FrameKind::reply);
        EXPECT_EQ(frame.id, id);
        EXPECT_EQ(frame.sequence, expected);
        replied = true;
        if (frame.hasData)
            reply = parsePropertyList(frame.payload);
    });
    connection.send({.id = id, .kind = FrameKind::request, .sequence = expected, .payload = *bytes});
    EXPECT_TRUE(spinUntil([&] { return replied; }));
    connection.onFrame([](PortConnection&, const Frame&) {});
    return reply;
}

int TestClient::createChannel()
{
    const auto server = connectTo("io.pelorus.TelephonyServer");
    const auto reply = request(*server, 1, makeDictionary({{"CreateLogChannel", name}}));
    if (!reply || !reply->dictionary())
        return -1;
    const Value port = reply->dictionary()->at("RemotePort");
    remotePort = port.string() ? *port.string() : "";
    const Value error = reply->dictionary()->at("Error");
    return error.integer() ? static_cast<int>(*error.integer()) : -1;
}

void TestClient::connectCommands()
{
    commands = connectTo(remotePort);
    commands->onClosed([this](PortConnection&) { commandsClosed = true; });
    commands->onFrame([](PortConnection&, const Frame&) {});
    EXPECT_TRUE(spinUntil([this] { return port != nullptr; }));
}

void TestClient::send(std::span<const std::byte> command)
{
    commands->send({.id = 0, .payload = command});
}

void TestClient::start()
{
    send(*serializePropertyList(startCommand({0xB0C1, 0xB0C2, 0xB179, 0xB17F, 0xB180, 0xB186}, {0, 1, 2})));
}

void TestClient::run()
{
    EXPECT_EQ(createChannel(), 0);
    connectCommands();
    start();
}

} // namespace pelorus::test
