#include "tests/telephonyd/ServerFixture.h"

#include <fmt/format.h>
#include <sys/socket.h>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

class TelephonyServerTest : public ServerFixture {
protected:
    /// Whether the server hung up on a peer that reads nothing else from it.
    static bool isHungUp(const RawPeer& peer)
    {
        char byte = 0;
        return ::recv(peer.descriptor(), &byte, 1, MSG_DONTWAIT) == 0;
    }
};

} // namespace

TEST_F(TelephonyServerTest, StreamsASimulationToItsClient)
{
    serve(simulated());
    TestClient client("client");
    EXPECT_EQ(client.createChannel(), 0);
    EXPECT_THAT(client.remotePort, testing::Not(IsEmpty()));
    client.connectCommands();
    const auto reply = client.command(makeDictionary({{"GetTechnology", "GetTechnology"}}));
    ASSERT_TRUE(reply && reply->dictionary());
    EXPECT_EQ(reply->dictionary()->at("GetTechnology"), Value("Osprey LTE"));

    spinOnce();
    EXPECT_THAT(client.messages, IsEmpty()); // not before the start command
    client.start();
    ASSERT_TRUE(spinUntil([&] { return client.messages.size() >= 5; }));
    std::vector<std::string> codes;
    for (std::size_t i = 0; i < 5; ++i)
        codes.push_back(codeOf(client.messages[i]));
    EXPECT_THAT(codes, ElementsAre("FF:0000", "01:B0C2", "01:B0C1", "FF:0001", "FF:0002"));
    EXPECT_THAT(lines,
                Contains("Osprey LTE: channel 1: client streaming, 6 log codes and 3 of the server's own"));
}

TEST_F(TelephonyServerTest, TakesBinaryCommands)
{
    serve(simulated());
    TestClient client("client");
    client.createChannel();
    client.connectCommands();
    client.send(*serializePropertyList(startCommand({0xB0C1}, {}), PropertyListForm::binary));
    ASSERT_TRUE(spinUntil([&] { return !client.messages.empty(); }));
    EXPECT_EQ(codeOf(client.messages[0]), "01:B0C1");
}

TEST_F(TelephonyServerTest, StreamsOnlyWhatTheLastStartCommandNames)
{
    serve(simulated(Pace::rate(2000)));
    TestClient client("client");
    client.createChannel();
    client.connectCommands();
    client.send(*serializePropertyList(startCommand({0xB17F}, {1})));
    ASSERT_TRUE(spinUntil([&] { return client.messages.size() >= 200; }));
    std::set<std::string> codes;
    for (const auto& message : client.messages)
        codes.insert(codeOf(message));
    EXPECT_THAT(codes, ElementsAre("01:B17F", "FF:0001"));

    client.command(startCommand({0xB179}, {})); // a request, so it is in force when the reply is here
    client.messages.clear();
    ASSERT_TRUE(spinUntil([&] { return client.messages.size() >= 200; }));
    codes.clear();
    for (std::size_t i = 150; i < client.messages.size(); ++i) // behind what was under way
        codes.insert(codeOf(client.messages[i]));
    EXPECT_THAT(codes, ElementsAre("01:B179"));
}

TEST_F(TelephonyServerTest, TellsEveryClientTheWholeStory)
{
    serve(simulated(Pace::rate(5000)));
    TestClient one("one");
    one.run();
    ASSERT_TRUE(spinUntil([&] { return one.messages.size() >= 500; }));
    TestClient other("other"); // comes late
    other.run();
    ASSERT_TRUE(spinUntil([&] { return other.messages.size() >= 500; }));
    for (std::size_t i = 0; i < 500; ++i) {
        ASSERT_EQ(one.messages[i].size(), other.messages[i].size());
        EXPECT_EQ(codeOf(one.messages[i]), codeOf(other.messages[i]));
        EXPECT_TRUE(
            std::equal(one.messages[i].begin() + 13, one.messages[i].end(), other.messages[i].begin() + 13));
    }
    EXPECT_NE(one.remotePort, other.remotePort);
}

TEST_F(TelephonyServerTest, RefusesAChannelWithoutAPort)
{
    serve(simulated());
    TestClient client("client");
    std::string why;
    const auto path = *PortDirectory::open(why)->socketPath("io.pelorus.TelephonyServer", why);
    const auto connection = PortConnection::connectTo(path, why);
    const auto errorOf = [&](const Value& request) {
        const auto reply = client.request(*connection, 1, request);
        EXPECT_FALSE(reply->dictionary()->find("RemotePort"));
        return *reply->dictionary()->at("Error").integer();
    };
    EXPECT_EQ(errorOf(makeDictionary({{"CreateLogChannel", "nobody"}})), 1);
    EXPECT_EQ(errorOf(makeDictionary({{"CreateLogChannel", ""}})), 1);
    EXPECT_EQ(errorOf(makeDictionary({{"CreateLogChannel", "../client"}})), 1);
    EXPECT_EQ(errorOf(makeDictionary({{"CreateLogChannel", 1}})), 1);
    EXPECT_EQ(errorOf(makeDictionary({{"Create", "client"}})), 1);
    EXPECT_EQ(errorOf(makeArray({})), 1);
    EXPECT_EQ(server->channelCount(), 0U);
}

TEST_F(TelephonyServerTest, RefusesAChannelWithoutABaseband)
{
    TelephonyServer::Settings settings = simulated();
    settings.makeSource = [](std::string& why) {
        why = "it is on fire";
        return nullptr;
    };
    serve(settings);
    TestClient client("client");
    EXPECT_EQ(client.createChannel(), 2);
    EXPECT_THAT(lines, ElementsAre("Osprey LTE: no channel (error 2): it is on fire"));
    EXPECT_EQ(client.createChannel(), 2);
    EXPECT_EQ(lines.size(), 1U) << "a client that tries again and again fills no log";
}

TEST_F(TelephonyServerTest, DropsItsChannelsWhenTheTechnologyChanges)
{
    serve(simulated());
    TestClient client("client");
    client.run();
    server->changeTechnology("Osprey LTE"); // it is already
    spinOnce();
    EXPECT_TRUE(client.isOpen());
    server->changeTechnology("Osprey GSM");
    EXPECT_EQ(server->channelCount(), 0U);
    EXPECT_TRUE(spinUntil([&] { return client.portClosed && client.commandsClosed; }));
    EXPECT_EQ(lines.back(),
              "Osprey LTE: channel 1: dropped, the technology is Osprey GSM now, no longer Osprey LTE");
    EXPECT_EQ(client.createChannel(), 0);
    client.connectCommands();
    const auto reply = client.command(makeDictionary({{"GetTechnology", "GetTechnology"}}));
    ASSERT_TRUE(reply);
    EXPECT_EQ(*reply, Value(makeDictionary({{"GetTechnology", "Osprey GSM"}})));
}

TEST_F(TelephonyServerTest, RefusesMoreThan256Channels)
{
    serve(simulated());
    TestClient client("client");
    for (int i = 0; i < 256; ++i)
        ASSERT_EQ(client.createChannel(), 0) << i;
    EXPECT_EQ(client.createChannel(), 3);
    EXPECT_EQ(server->channelCount(), 256U);
}

TEST_F(TelephonyServerTest, AnswersOtherRequestsWithoutData)
{
    serve(simulated());
    TestClient client("client");
    client.createChannel();
    client.connectCommands();
    EXPECT_FALSE(client.command(makeDictionary({{"GetWeather", "GetWeather"}})));
    EXPECT_FALSE(client.request(*client.commands, 5, makeDictionary({{"GetTechnology", "GetTechnology"}})));

    std::string why;
    const auto path = *PortDirectory::open(why)->socketPath("io.pelorus.TelephonyServer", why);
    const auto connection = PortConnection::connectTo(path, why);
    EXPECT_FALSE(client.request(*connection, 7, makeDictionary({})));
}

TEST_F(TelephonyServerTest, IgnoresCommandsThatItCannotFollow)
{
    serve(simulated());
    TestClient client("client");
    client.createChannel();
    client.connectCommands();
    lines.clear();
    client.command(makeDictionary({{"SetState", "Sleeping"}}));
    const std::vector<std::byte> noise(100, std::byte{'?'});
    client.send(noise);
    client.send({});
    EXPECT_TRUE(client.command(makeDictionary({{"GetTechnology", "GetTechnology"}}))); // still there
    EXPECT_THAT(client.messages, IsEmpty());
    EXPECT_THAT(lines, ElementsAre("Osprey LTE: channel 1: ignored: a \"SetState\" that is not \"Streaming\"",
                                   HasSubstr("ignored: a command that is no property list"),
                                   HasSubstr("ignored: a command that is no property list")));
    client.start();
    EXPECT_TRUE(spinUntil([&] { return !client.messages.empty(); }));
}

TEST_F(TelephonyServerTest, EndsTheChannelWhenTheClientsPortGoes)
{
    serve(simulated());
    TestClient client("client");
    client.run();
    ASSERT_TRUE(spinUntil([&] { return !client.messages.empty(); }));
    client.port->close();
    EXPECT_TRUE(spinUntil([&] { return client.commandsClosed; }));
    EXPECT_EQ(server->channelCount(), 0U);
    EXPECT_THAT(sockets(), ElementsAre("client", "io.pelorus.TelephonyServer"));
}

TEST_F(TelephonyServerTest, EndsTheChannelWhenTheCommandPortIsClosed)
{
    serve(simulated());
    TestClient client("client");
    client.run();
    ASSERT_TRUE(spinUntil([&] { return !client.messages.empty(); }));
    client.commands->close();
    EXPECT_TRUE(spinUntil([&] { return client.portClosed; }));
    EXPECT_EQ(server->channelCount(), 0U);
}

TEST_F(TelephonyServerTest, DropsAClientThatDoesNotConnectToItsCommandPort)
{
    TelephonyServer::Settings settings = simulated();
    EXPECT_EQ(settings.patience, 10s);
    settings.patience = 50ms;
    serve(settings);
    TestClient slow("slow");
    EXPECT_EQ(slow.createChannel(), 0);
    TestClient quick("quick");
    quick.run();
    EXPECT_TRUE(spinUntil([&] { return slow.portClosed; }));
    spinOnce();
    EXPECT_TRUE(quick.isOpen());
    EXPECT_EQ(server->channelCount(), 1U);
}

TEST_F(TelephonyServerTest, LetsOnlyOneClientUseACommandPort)
{
    serve(simulated());
    TestClient client("client");
    client.run();
    std::string why;
    const auto intruder =
        PortConnection::connectTo(*PortDirectory::open(why)->socketPath(client.remotePort, why), why);
    EXPECT_TRUE(spinUntil([&] { return !intruder || !intruder->isOpen(); }));
    EXPECT_TRUE(spinUntil([&] { return !client.messages.empty(); }));
    EXPECT_TRUE(client.isOpen());
}

TEST_F(TelephonyServerTest, AStalledClientHoldsUpNobody)
{
    serve(simulated(Pace::rate(1e9))); // more than anybody can take
    TestClient stalled("stalled", false);
    stalled.run();
    TestClient client("client");
    client.run();
    ASSERT_TRUE(spinUntil([&] { return client.messages.size() >= 100'000; }));
    EXPECT_TRUE(stalled.isOpen());
}

TEST_F(TelephonyServerTest, CutsOffPeersThatDoNotKeepToTheFraming)
{
    serve(simulated(Pace::rate(1000)));
    TestClient client("client");
    client.run();
    const std::string serverPath = path("io.pelorus.TelephonyServer");
    const std::string garbage[] = {
        std::string(4096, '\x5A'), wireFrame(16 * 1024 * 1024 + 1, 1, 1, 1), // too long
        wireFrame(0, 1, 3, 1),                                               // a kind that is none
    };
    for (const std::string& bytes : garbage) {
        const RawPeer peer = RawPeer::connectTo(serverPath);
        ASSERT_TRUE(peer.send(bytes));
        EXPECT_TRUE(spinUntil([&] { return isHungUp(peer); }));
    }
    TestClient rude("rude"); // on its command port
    rude.createChannel();
    const RawPeer peer = RawPeer::connectTo(path(rude.remotePort));
    ASSERT_TRUE(peer.send(garbage[2]));
    EXPECT_TRUE(spinUntil([&] { return rude.portClosed; }));

    const std::size_t before = client.messages.size();
    EXPECT_TRUE(spinUntil([&] { return client.messages.size() > before + 10; }));
    EXPECT_TRUE(client.isOpen());
}

TEST_F(TelephonyServerTest, SurvivesClientsThatDieInAFrame)
{
    serve(simulated(Pace::rate(1000)));
    TestClient client("client");
    client.run();
    for (const std::size_t length : {1U, 15U, 16U, 40U}) {
        RawPeer peer = RawPeer::connectTo(path("io.pelorus.TelephonyServer"));
        ASSERT_TRUE(peer.send(wireFrame(100, 1, 1, 1, std::string(100, 'x')).substr(0, length)));
        spinOnce();
        peer.close();
    }
    TestClient dying("dying");
    dying.createChannel();
    RawPeer peer = RawPeer::connectTo(path(dying.remotePort));
    ASSERT_TRUE(peer.send(oneWay(std::string(100, 'x')).substr(0, 50)));
    spinOnce();
    peer.close();
    EXPECT_TRUE(spinUntil([&] { return dying.portClosed; }));
    const std::size_t before = client.messages.size();
    EXPECT_TRUE(spinUntil([&] { return client.messages.size() > before + 10; }));
}

TEST_F(TelephonyServerTest, ClosesEverythingWhenItEnds)
{
    serve(simulated());
    TestClient client("client");
    client.run();
    ASSERT_TRUE(spinUntil([&] { return !client.messages.empty(); }));
    EXPECT_THAT(sockets(), SizeIs(3));
    server.reset();
    EXPECT_THAT(sockets(), ElementsAre("client"));
    EXPECT_TRUE(spinUntil([&] { return client.portClosed && client.commandsClosed; }));
}

TEST_F(TelephonyServerTest, IsTheOnlyOneInItsDirectory)
{
    serve(simulated());
    std::string why;
    TelephonyServer second(*PortDirectory::open(why), simulated());
    EXPECT_EQ(second.listen(why), PortListener::Outcome::alreadyExisted);
    EXPECT_THAT(why, HasSubstr(path("io.pelorus.TelephonyServer")));
    TestClient client("client"); // the first one does not notice
    EXPECT_EQ(client.createChannel(), 0);
}

} // namespace pelorus::test
