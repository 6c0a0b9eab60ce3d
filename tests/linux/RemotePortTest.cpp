#include "platform/linux/LinuxPlatform.h"

#include "tests/linux/EventLoop.h"
#include "tests/linux/PortFixture.h"

#include <future>

namespace pelorus {

using namespace test;
using namespace std::chrono_literals;
using Clock = std::chrono::steady_clock;

namespace {

class RemotePortTest : public PortFixture {
protected:
    /// A remote port that this function serves.
    void connect(std::function<void(RawPeer&)> serve)
    {
        server = std::make_unique<RawServer>(path("remote"), std::move(serve));
        port = platform.createRemoteMessagePort("remote");
        ASSERT_TRUE(port);
    }
    PortReply send(std::string_view payload, Seconds receiveTimeout, Seconds sendTimeout = 5s)
    {
        return platform.sendPortRequest(*port, 7, std::as_bytes(std::span(payload)), sendTimeout,
                                        receiveTimeout);
    }
    static std::string textOf(const PortReply& reply)
    {
        if (!reply.reply)
            return "status " + std::to_string(reply.status) + ", nothing";
        return "status " + std::to_string(reply.status) + ", \"" +
               std::string(reinterpret_cast<const char*>(reply.reply->data()), reply.reply->size()) + "\"";
    }

    LinuxPlatform platform;
    std::unique_ptr<RawServer> server; // before the port, which it waits for
    std::shared_ptr<MessagePort> port;
};

} // namespace

TEST_F(RemotePortTest, NobodyListensIsNoPort)
{
    EXPECT_FALSE(platform.createRemoteMessagePort("nobody"));
    EXPECT_FALSE(platform.createRemoteMessagePort("../nobody"));
    EXPECT_FALSE(platform.createRemoteMessagePort(""));
}

TEST_F(RemotePortTest, RequestAndOneWayOnTheWire)
{
    connect([](RawPeer& peer) {
        EXPECT_EQ(peer.receive(19), wireFrame(3, 7, 1, 1, "ask"));
        peer.send(wireFrame(6, 7, 2, 1, "answer"));
        EXPECT_EQ(peer.receive(20), wireFrame(4, 7, 0, 0, "tell"));
        EXPECT_EQ(peer.receive(17), wireFrame(1, 7, 1, 2, "?"));
        peer.send(wireFrame(0, 7, 2, 2));
        EXPECT_EQ(peer.receive(16), wireFrame(0, 7, 1, 3));
        peer.send(wireFrame(0xFFFFFFFF, 0, 2, 3));
        peer.receive(1);
    });
    EXPECT_EQ(textOf(send("ask", 5s)), "status 0, \"answer\"");
    EXPECT_EQ(textOf(send("tell", 0s)), "status 0, nothing");
    EXPECT_EQ(textOf(send("?", 5s)), "status 0, \"\"") << "an empty reply is a reply";
    EXPECT_EQ(textOf(send("", 5s)), "status 0, nothing") << "a reply without data";
    EXPECT_TRUE(platform.isPortValid(*port));
    port.reset();
}

TEST_F(RemotePortTest, OtherFramesAndOtherSequencesAreNoReply)
{
    connect([](RawPeer& peer) {
        peer.receive(19);
        peer.send(wireFrame(5, 7, 2, 99, "other") + oneWay("news", 7) + wireFrame(3, 7, 1, 1, "ask") +
                  wireFrame(4, 7, 2, 1, "mine"));
        peer.receive(1);
    });
    EXPECT_EQ(textOf(send("ask", 5s)), "status 0, \"mine\"");
    port.reset();
}

TEST_F(RemotePortTest, ReplyInPieces)
{
    connect([](RawPeer& peer) {
        peer.receive(19);
        for (const char byte : wireFrame(4, 7, 2, 1, "slow"))
            peer.send(std::string(1, byte));
        peer.receive(1);
    });
    EXPECT_EQ(textOf(send("ask", 5s)), "status 0, \"slow\"");
    port.reset();
}

TEST_F(RemotePortTest, NoReplyInTimeIsMinusTwoAndALateOneIsIgnored)
{
    connect([](RawPeer& peer) {
        peer.receive(21);
        peer.receive(22); // the second request comes when the first has given up
        peer.send(wireFrame(4, 7, 2, 1, "late") + wireFrame(6, 7, 2, 2, "second"));
        peer.receive(1);
    });
    const auto before = Clock::now();
    EXPECT_EQ(textOf(send("first", 0.05s)), "status -2, nothing");
    EXPECT_GE(Clock::now() - before, 50ms);
    EXPECT_EQ(textOf(send("second", 5s)), "status 0, \"second\"");
    EXPECT_TRUE(platform.isPortValid(*port));
    port.reset();
}

TEST_F(RemotePortTest, CloseWhileAReplyIsAwaitedIsMinusTwoAtOnce)
{
    connect([](RawPeer& peer) { peer.receive(19); });
    const auto before = Clock::now();
    EXPECT_EQ(textOf(send("ask", 60s)), "status -2, nothing");
    EXPECT_LT(Clock::now() - before, 30s);
    EXPECT_FALSE(platform.isPortValid(*port));
    EXPECT_EQ(textOf(send("ask", 60s)), "status -3, nothing");
}

TEST_F(RemotePortTest, ReplyThatTheCloseFollowsAtOnceCounts)
{
    connect([](RawPeer& peer) {
        peer.receive(19);
        peer.send(wireFrame(3, 7, 2, 1, "bye"));
    });
    EXPECT_EQ(textOf(send("ask", 5s)), "status 0, \"bye\"");
}

TEST_F(RemotePortTest, ReplyThatBreaksTheRulesCutsTheConnection)
{
    connect([](RawPeer& peer) {
        peer.receive(19);
        peer.send(wireFrame(16777217, 7, 2, 1));
        EXPECT_EQ(peer.receive(1), "");
    });
    EXPECT_EQ(textOf(send("ask", 60s)), "status -2, nothing");
    EXPECT_FALSE(platform.isPortValid(*port));
}

TEST_F(RemotePortTest, SendOnAClosedPortIsMinusThree)
{
    connect([](RawPeer&) {});
    server.reset(); // joins: the peer has closed by now
    EXPECT_EQ(textOf(send("tell", 0s)), "status -3, nothing");
    EXPECT_FALSE(platform.isPortValid(*port));
}

TEST_F(RemotePortTest, SendOnAnInvalidatedPortIsMinusThree)
{
    connect([](RawPeer& peer) { EXPECT_EQ(peer.receive(1), ""); });
    platform.invalidatePort(*port);
    EXPECT_FALSE(platform.isPortValid(*port));
    EXPECT_EQ(textOf(send("ask", 1s)), "status -3, nothing");
}

TEST_F(RemotePortTest, SendThatThePeerDoesNotTakeInTimeIsMinusOne)
{
    std::promise<void> timedOut;
    const std::string large(4'000'000, 'x');
    connect([&](RawPeer& peer) {
        timedOut.get_future().wait();
        EXPECT_EQ(peer.receive(4000016), wireFrame(4000000, 7, 0, 0, large)) << "still whole on the wire";
        EXPECT_EQ(peer.receive(21), wireFrame(5, 7, 0, 0, "third"));
        peer.receive(1);
    });
    const auto before = Clock::now();
    EXPECT_EQ(textOf(send(large, 0s, 0.05s)), "status -1, nothing");
    EXPECT_EQ(textOf(send("second", 0s, 0.05s)), "status -1, nothing") << "not even begun";
    EXPECT_LT(Clock::now() - before, 5s);
    EXPECT_TRUE(platform.isPortValid(*port));
    timedOut.set_value();
    EXPECT_EQ(textOf(send("third", 0s)), "status 0, nothing");
    port.reset();
    server.reset(); // its thread uses what is local here
}

TEST_F(RemotePortTest, LargestMessageGoesThroughAndOneMoreByteDoesNot)
{
    connect([](RawPeer& peer) {
        EXPECT_EQ(peer.receive(16777232).substr(0, 16), wireFrame(16777216, 7, 0, 0));
        peer.receive(1);
    });
    EXPECT_EQ(send(std::string(16777216, 'x'), 0s).status, 0);
    EXPECT_EQ(send(std::string(16777217, 'x'), 0s).status, -1);
    port.reset();
}

TEST_F(RemotePortTest, BreakIsSaidOnceOnTheEventLoop)
{
    connect([](RawPeer& peer) { peer.receive(19); });
    int said = 0;
    platform.setInvalidationCallback(*port, [&](MessagePort& broken) {
        EXPECT_EQ(&broken, port.get());
        ++said;
    });
    send("ask", 60s);
    EXPECT_EQ(said, 0) << "not inside the send";
    EXPECT_TRUE(spinUntil([&] { return said == 1; }));
    platform.invalidatePort(*port);
    spinOnce();
    EXPECT_EQ(said, 1);
}

TEST_F(RemotePortTest, BreakWhileIdleIsSaidToo)
{
    connect([](RawPeer&) {});
    int said = 0;
    platform.setInvalidationCallback(*port, [&](MessagePort&) {
        ++said;
        port.reset();
    });
    EXPECT_TRUE(spinUntil([&] { return said == 1; }));
}

TEST_F(RemotePortTest, NegativeAndHugeTimeouts)
{
    connect([](RawPeer& peer) {
        peer.receive(19);
        peer.send(wireFrame(2, 7, 2, 1, "ok"));
        peer.receive(1);
    });
    EXPECT_EQ(textOf(send("ask", Seconds(1e300), Seconds(1e300))), "status 0, \"ok\"");
    EXPECT_EQ(textOf(send("x", Seconds(-1), Seconds(-1))), "status 0, nothing")
        << "as far as it needs no waiting";
    port.reset();
}

} // namespace pelorus
