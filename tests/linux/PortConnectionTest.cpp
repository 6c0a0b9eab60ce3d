#include "platform/linux/PortConnection.h"

#include "tests/linux/ConnectedPair.h"
#include "tests/linux/EventLoop.h"

#include <sys/socket.h>

namespace pelorus {

using namespace test;
using namespace std::chrono_literals;

namespace {

class PortConnectionTest : public ConnectedPair {};

} // namespace

TEST_F(PortConnectionTest, DeliversFramesInOrderThenTheClose)
{
    connection->onFrame([&](PortConnection& from, const Frame& frame) {
        EXPECT_EQ(&from, connection.get());
        events += std::to_string(frame.id) + ' ';
    });
    connection->onClosed([&](PortConnection&) { events += "closed"; });
    peer.send(oneWay("a", 1) + oneWay("b", 2) + oneWay("c", 3));
    peer.close();
    EXPECT_TRUE(spinUntil([&] { return !connection->isOpen(); }));
    EXPECT_TRUE(spinUntil([&] { return events == "1 2 3 closed"; })) << events;
    spinOnce();
    EXPECT_EQ(events, "1 2 3 closed");
    EXPECT_FALSE(connection->send({.id = 1}));
}

TEST_F(PortConnectionTest, FramesWaitForTheirCallbackEvenWhenThePeerIsGone)
{
    connection->onClosed([&](PortConnection&) { events += "closed"; });
    std::string stream;
    for (int number = 0; number < 1000; ++number)
        stream += oneWay(std::string(150, 'x'), number); // more than is read at once
    ASSERT_TRUE(peer.send(stream));
    peer.close();
    spinOnce();
    EXPECT_EQ(events, "");
    int next = 0;
    connection->onFrame([&](PortConnection&, const Frame& frame) { next += frame.id == next; });
    EXPECT_TRUE(spinUntil([&] { return events == "closed"; }));
    EXPECT_EQ(next, 1000);
}

TEST_F(PortConnectionTest, CloseInTheMiddleOfAFrameDropsThatFrameOnly)
{
    connection->onFrame(
        [&](PortConnection&, const Frame& frame) { events += std::to_string(frame.id) + ' '; });
    connection->onClosed([&](PortConnection&) { events += "closed"; });
    peer.send(oneWay("whole", 1) + oneWay("cut short", 2).substr(0, 20));
    peer.close();
    EXPECT_TRUE(spinUntil([&] { return events == "1 closed"; })) << events;
}

TEST_F(PortConnectionTest, PeerThatBreaksTheRulesIsCutOff)
{
    connection->onFrame(
        [&](PortConnection&, const Frame& frame) { events += std::to_string(frame.id) + ' '; });
    connection->onClosed([&](PortConnection&) { events += "closed"; });
    peer.send(oneWay("good", 1) + wireFrame(16777217, 2, 0, 0) + oneWay("late", 3));
    EXPECT_TRUE(spinUntil([&] { return events == "1 closed"; })) << events;
    EXPECT_EQ(peer.receive(1), "") << "the peer sees the end";
}

TEST_F(PortConnectionTest, CallbackMayCloseItsConnection)
{
    connection->onFrame([&](PortConnection& from, const Frame&) {
        events += "frame ";
        from.close();
    });
    connection->onClosed([&](PortConnection&) { events += "closed"; });
    peer.send(oneWay("a") + oneWay("b"));
    EXPECT_EQ(receiveFrom(peer, 1), "");
    spinOnce();
    EXPECT_EQ(events, "frame ");
}

TEST_F(PortConnectionTest, CallbackMayReleaseItsConnection)
{
    const std::weak_ptr<PortConnection> observer = connection;
    std::string payload;
    connection->onFrame([&](PortConnection&, const Frame& frame) {
        connection.reset();
        payload.assign(reinterpret_cast<const char*>(frame.payload.data()), frame.payload.size());
    });
    peer.send(oneWay("still there") + oneWay("b"));
    EXPECT_TRUE(spinUntil([&] { return observer.expired(); }));
    spinOnce();
    EXPECT_EQ(payload, "still there");
    EXPECT_EQ(peer.receive(1), "");
}

TEST_F(PortConnectionTest, CallbackMayBeReplacedFromWithinItself)
{
    connection->onFrame([&, keep = std::string("first ")](PortConnection& from, const Frame&) {
        from.onFrame([&](PortConnection&, const Frame&) { events += "second "; });
        events += keep;
    });
    peer.send(oneWay("a") + oneWay("b") + oneWay("c"));
    EXPECT_TRUE(spinUntil([&] { return events == "first second second "; })) << events;
}

TEST_F(PortConnectionTest, AnswersRepeatIdAndSequence)
{
    connection->onFrame([](PortConnection& from, const Frame& frame) {
        if (frame.id == 5)
            from.reply(frame, std::as_bytes(std::span("yes", 3)));
        else
            from.reply(frame, std::nullopt);
    });
    peer.send(wireFrame(0, 5, 1, 77) + wireFrame(0, 6, 1, 78));
    EXPECT_EQ(receiveFrom(peer, 35), wireFrame(3, 5, 2, 77, "yes") + wireFrame(0xFFFFFFFF, 6, 2, 78));
}

TEST_F(PortConnectionTest, SaysHowMuchIsUnsentAndWhenItIsGone)
{
    const std::string payload(1000, 'x');
    const Frame frame = {.payload = std::as_bytes(std::span(payload))};
    int drained = 0;
    connection->onDrained([&](PortConnection& drainedOne) {
        EXPECT_EQ(drainedOne.unsent(), 0u);
        ++drained;
    });
    for (int count = 0; count < 1000; ++count)
        ASSERT_TRUE(connection->send(frame));
    EXPECT_EQ(connection->unsent(), 1016000u) << "nothing is sent before the event loop runs";
    spinOnce();
    EXPECT_GT(connection->unsent(), 100000u) << "the peer has not read yet";
    EXPECT_EQ(drained, 0);
    const std::string received = receiveFrom(peer, 1016000);
    ASSERT_EQ(received.size(), 1016000u);
    EXPECT_EQ(received.substr(1014984), wireFrame(1000, 0, 0, 0, payload));
    EXPECT_TRUE(spinUntil([&] { return drained == 1; }));
}

TEST_F(PortConnectionTest, PeerThatReadsNoRepliesIsNotReadFromEither)
{
    std::size_t answered = 0;
    const Bytes answer(100000);
    connection->onFrame([&](PortConnection& from, const Frame& frame) {
        ++answered;
        from.reply(frame, std::span(answer));
    });
    std::string requests;
    for (std::uint32_t sequence = 1; sequence <= 1000; ++sequence)
        requests += wireFrame(0, 0, 1, sequence);
    ASSERT_TRUE(peer.send(requests));
    spinOnce();
    EXPECT_LE(connection->unsent(), PortConnection::kReadWhileUnsent + 100016);
    EXPECT_LT(answered, 50u);
    EXPECT_EQ(receiveFrom(peer, 100016000).size(), 100016000u);
    EXPECT_EQ(answered, 1000u);
}

TEST_F(PortConnectionTest, FramesOfAPeerThatWentBeforeItsAnswersAreDelivered)
{
    for (const std::size_t length : {std::size_t{0}, std::size_t{100000}}) { // all sent, and far from it
        std::vector<std::uint32_t> sequences;
        const Bytes answer(length);
        events.clear();
        connection->onFrame([&](PortConnection& from, const Frame& frame) {
            sequences.push_back(frame.sequence);
            from.reply(frame, std::span(answer));
        });
        connection->onClosed([&](PortConnection&) { events += "closed"; });
        std::string requests;
        for (std::uint32_t sequence = 1; sequence <= 1000; ++sequence)
            requests += wireFrame(100, 0, 1, sequence, std::string(100, 'q'));
        ASSERT_TRUE(peer.send(requests)); // more than is read at once
        peer.close();
        ASSERT_TRUE(spinUntil([&] { return events == "closed"; }));
        ASSERT_EQ(sequences.size(), 1000u);
        EXPECT_TRUE(std::is_sorted(sequences.begin(), sequences.end()));
        EXPECT_EQ(sequences.back(), 1000u);
        connection.reset();
        SetUp();
    }
}

TEST_F(PortConnectionTest, SeesTheCloseWithoutTheEventLoop)
{
    EXPECT_TRUE(connection->isOpen());
    peer.close();
    EXPECT_FALSE(connection->isOpen());
}

TEST_F(PortConnectionTest, TooLongAPayloadIsNotSent)
{
    const Bytes payload(16777217);
    EXPECT_FALSE(connection->send({.payload = payload}));
    EXPECT_EQ(connection->unsent(), 0u);
}

TEST_F(PortConnectionTest, ExceptionInACallbackEndsTheProgram)
{
    connection->onFrame([](PortConnection&, const Frame&) { throw std::runtime_error("from the callback"); });
    peer.send(oneWay("a"));
    // Without the boundary, the exception would come out of processEvents() and be caught here.
    const auto run = [] {
        try {
            spinOnce();
        } catch (...) {
            ::_exit(0);
        }
    };
    EXPECT_EXIT(run(), testing::KilledBySignal(SIGABRT), "from the callback");
}

} // namespace pelorus
