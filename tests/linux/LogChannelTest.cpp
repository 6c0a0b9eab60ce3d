#include "platform/linux/LinuxPlatform.h"

#include "platform/PropertyList.h"
#include "tests/linux/EventLoop.h"
#include "tests/linux/PortFixture.h"

namespace pelorus {

using namespace test;
using namespace std::string_literals;

namespace {

std::string list(const std::string& entries)
{
    return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\"><dict>" + entries +
           "</dict></plist>";
}

class LogChannelTest : public PortFixture {
protected:
    /// A telephony server that answers the one request with these bytes.
    void serve(std::optional<std::string> answer)
    {
        server =
            std::make_unique<RawServer>(path("io.pelorus.TelephonyServer"), [this, answer](RawPeer& peer) {
                const std::string header = peer.receive(16);
                const auto length = static_cast<unsigned char>(header.at(0)) +
                                    256u * static_cast<unsigned char>(header.at(1));
                EXPECT_EQ(header, wireFrame(length, 1, 1, 1));
                request = peer.receive(length);
                if (answer)
                    peer.send(wireFrame(static_cast<std::uint32_t>(answer->size()), 1, 2, 1, *answer));
                else
                    peer.send(wireFrame(0xFFFFFFFF, 1, 2, 1));
                peer.receive(1);
            });
    }
    Platform::LogChannel create()
    {
        const auto connection = platform.createServerConnection([] {});
        EXPECT_TRUE(connection);
        const auto channel =
            platform.createLogChannel(*connection, "io.pelorus.BasebandStateReport.LogChannel");
        return channel;
    }
    void expectChannel(std::optional<std::string> answer, std::int32_t error, const std::string& remotePort)
    {
        serve(answer);
        const auto channel = create();
        server.reset();
        ::unlink(path("io.pelorus.TelephonyServer").c_str());
        EXPECT_EQ(channel.error, error) << answer.value_or("no data");
        EXPECT_EQ(channel.remotePort, remotePort);
    }

    LinuxPlatform platform;
    std::string request;
    std::unique_ptr<RawServer> server;
};

} // namespace

TEST_F(LogChannelTest, NoServerIsNoConnection)
{
    EXPECT_FALSE(platform.createServerConnection([] {}));
}

TEST_F(LogChannelTest, AsksWithADictionaryAndReadsTheRemotePort)
{
    expectChannel(list("<key>Error</key><integer>0</integer><key>RemotePort</key><string>far</string>"), 0,
                  "far");
    EXPECT_TRUE(request.starts_with("<?xml")) << request;
    const Value asked = parsePropertyList(std::as_bytes(std::span(request)));
    ASSERT_TRUE(asked.dictionary());
    EXPECT_EQ(asked.dictionary()->size(), 1u);
    EXPECT_EQ(asked.dictionary()->at("CreateLogChannel"), Value("io.pelorus.BasebandStateReport.LogChannel"));
}

TEST_F(LogChannelTest, BinaryReplyIsReadToo)
{
    // {"Error": 0, "RemotePort": "x"}
    const std::string binary = "bplist00"
                               "\xD2\x01\x02\x03\x04"
                               "\x55"
                               "Error"
                               "\x5A"
                               "RemotePort"
                               "\x10\x00"
                               "\x51x"
                               "\x08\x0D\x13\x1E\x20"
                               "\0\0\0\0\0\0\x01\x01"
                               "\0\0\0\0\0\0\0\x05"
                               "\0\0\0\0\0\0\0\0"
                               "\0\0\0\0\0\0\0\x22"s;
    expectChannel(binary, 0, "x");
}

TEST_F(LogChannelTest, ServerErrorsComeThrough)
{
    for (const int error : {1, 2, 3, -7})
        expectChannel(list("<key>Error</key><integer>" + std::to_string(error) + "</integer>"), error, "");
}

TEST_F(LogChannelTest, MissingOrOddRemotePortIsEmpty)
{
    expectChannel(list("<key>Error</key><integer>0</integer>"), 0, "");
    expectChannel(list("<key>Error</key><integer>0</integer><key>RemotePort</key><integer>5</integer>"), 0,
                  "");
}

TEST_F(LogChannelTest, ReplyThatMakesNoSenseIsMinusFour)
{
    expectChannel(std::nullopt, -4, "");
    expectChannel("", -4, "");
    expectChannel("no list", -4, "");
    expectChannel("<?xml version=\"1.0\"?><plist version=\"1.0\"><array/></plist>", -4, "");
    expectChannel(list(""), -4, "");
    expectChannel(list("<key>RemotePort</key><string>far</string>"), -4, "");
    expectChannel(list("<key>Error</key><string>0</string><key>RemotePort</key><string>far</string>"), -4,
                  "");
    expectChannel(list("<key>Error</key><integer>4294967296</integer>"), -4, "");
}

TEST_F(LogChannelTest, FailureOfTheConnectionGivesItsStatus)
{
    server = std::make_unique<RawServer>(path("io.pelorus.TelephonyServer"),
                                         [](RawPeer& peer) { peer.receive(16); });
    const auto connection = platform.createServerConnection([] {});
    ASSERT_TRUE(connection);
    EXPECT_EQ(platform.createLogChannel(*connection, "name").error, -2)
        << "closed while the reply is awaited";
    EXPECT_EQ(platform.createLogChannel(*connection, "name").error, -3);
}

TEST_F(LogChannelTest, NotificationsAreCountedAndWaitForTheEventLoop)
{
    server = std::make_unique<RawServer>(path("io.pelorus.TelephonyServer"), [](RawPeer& peer) {
        peer.receive(17);
        const std::string answer = list("<key>Error</key><integer>0</integer>");
        peer.send(oneWay("", 2) + oneWay("", 3) + oneWay("more", 2) + wireFrame(0, 2, 1, 1) +
                  wireFrame(static_cast<std::uint32_t>(answer.size()), 1, 2, 1, answer) + oneWay("", 2));
        peer.receive(100000);
    });
    int notifications = 0;
    auto connection = platform.createServerConnection([&] { ++notifications; });
    ASSERT_TRUE(connection);
    EXPECT_EQ(platform.createLogChannel(*connection, "name").error, 0);
    EXPECT_EQ(notifications, 0);
    EXPECT_TRUE(spinUntil([&] { return notifications == 3; }));
    spinOnce();
    EXPECT_EQ(notifications, 3);
}

TEST_F(LogChannelTest, ReleasedConnectionNotifiesNoMore)
{
    server = std::make_unique<RawServer>(path("io.pelorus.TelephonyServer"), [](RawPeer& peer) {
        peer.receive(17);
        const std::string answer = list("<key>Error</key><integer>0</integer>");
        peer.send(oneWay("", 2) + wireFrame(static_cast<std::uint32_t>(answer.size()), 1, 2, 1, answer));
        peer.receive(100000); // returns when the client's end is closed
    });
    int notifications = 0;
    auto connection = platform.createServerConnection([&] { ++notifications; });
    EXPECT_EQ(platform.createLogChannel(*connection, "name").error, 0);
    connection.reset();
    server.reset();
    spinOnce();
    EXPECT_EQ(notifications, 0);
}

} // namespace pelorus
