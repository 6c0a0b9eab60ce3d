#include "platform/linux/LinuxPlatform.h"

#include "tests/linux/EventLoop.h"
#include "tests/linux/PortFixture.h"

#include <cstring>
#include <sys/wait.h>

namespace pelorus {

using namespace test;

namespace {

std::string textOf(std::span<const std::byte> bytes)
{
    return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

class LocalPortTest : public PortFixture {
protected:
    std::shared_ptr<MessagePort> make(PortMessageCallback callback)
    {
        auto made = platform.createLocalMessagePort("local", std::move(callback));
        EXPECT_TRUE(made.port);
        EXPECT_FALSE(made.alreadyExisted);
        return made.port;
    }
    PortMessageCallback note()
    {
        return [this](std::int32_t id, std::span<const std::byte> payload) -> std::optional<Bytes> {
            events += std::to_string(id) + ":" + textOf(payload) + " ";
            return std::nullopt;
        };
    }

    LinuxPlatform platform;
    std::string events;
};

} // namespace

TEST_F(LocalPortTest, DeliversOnlyOnceToldTo)
{
    const auto port = make(note());
    const RawPeer peer = RawPeer::connectTo(path("local"));
    peer.send(oneWay("a", 0) + oneWay("b", 1));
    spinOnce();
    EXPECT_EQ(events, "");
    platform.deliverOnMainQueue(*port);
    EXPECT_EQ(events, "") << "not inside the call either";
    EXPECT_TRUE(spinUntil([&] { return events == "0:a 1:b "; })) << events;
}

TEST_F(LocalPortTest, DeliversWhatArrivedBeforeItIsInvalidated)
{
    int received = 0;
    const auto port = make([&](std::int32_t id, std::span<const std::byte>) -> std::optional<Bytes> {
        received += id == received;
        return std::nullopt;
    });
    platform.deliverOnMainQueue(*port);
    RawPeer gone = RawPeer::connectTo(path("local"));
    ASSERT_TRUE(gone.send(oneWay("", 0)));
    ASSERT_TRUE(spinUntil([&] { return received == 1; }));
    std::string messages;
    for (int number = 1; number < 1000; ++number)
        messages += oneWay(std::string(150, 'x'), number); // more than is read at once
    ASSERT_TRUE(gone.send(messages));
    gone.close();
    platform.setInvalidationCallback(*port, [&](MessagePort&) { events += std::to_string(received); });
    platform.invalidatePort(*port);
    EXPECT_EQ(events, "1000");
    spinOnce();
    EXPECT_EQ(received, 1000);
}

TEST_F(LocalPortTest, EveryConnectionCounts)
{
    const auto port = make(note());
    platform.deliverOnMainQueue(*port);
    const RawPeer first = RawPeer::connectTo(path("local"));
    RawPeer second = RawPeer::connectTo(path("local"));
    second.send(oneWay("second"));
    EXPECT_TRUE(spinUntil([&] { return events == "0:second "; }));
    second.close();
    first.send(oneWay("first"));
    EXPECT_TRUE(spinUntil([&] { return events == "0:second 0:first "; }));
    EXPECT_TRUE(platform.isPortValid(*port)) << "a connection that ends leaves the port as it is";
}

TEST_F(LocalPortTest, AnswersRequestsOnly)
{
    const auto port = make([](std::int32_t id, std::span<const std::byte> payload) -> std::optional<Bytes> {
        if (id == 9)
            return std::nullopt;
        return Bytes(payload.rbegin(), payload.rend());
    });
    platform.deliverOnMainQueue(*port);
    const RawPeer peer = RawPeer::connectTo(path("local"));
    peer.send(oneWay("no answer", 4) + wireFrame(3, 4, 1, 100, "abc") + wireFrame(0, 4, 1, 101) +
              wireFrame(0, 9, 1, 102) + wireFrame(1, 4, 2, 103, "r"));
    peer.send(wireFrame(1, 4, 1, 104, "z"));
    const std::string expected = wireFrame(3, 4, 2, 100, "cba") + wireFrame(0, 4, 2, 101) +
                                 wireFrame(0xFFFFFFFF, 9, 2, 102) + wireFrame(1, 4, 2, 104, "z");
    EXPECT_EQ(receiveFrom(peer, expected.size()), expected);
}

TEST_F(LocalPortTest, OneMadeASecondTimeIsInert)
{
    const auto first = make(note());
    platform.deliverOnMainQueue(*first);
    const auto second = platform.createLocalMessagePort("local", note());
    EXPECT_TRUE(second.alreadyExisted);
    ASSERT_TRUE(second.port);
    platform.deliverOnMainQueue(*second.port);
    int invalidations = 0;
    platform.setInvalidationCallback(*second.port, [&](MessagePort&) { ++invalidations; });
    platform.invalidatePort(*second.port);
    EXPECT_EQ(invalidations, 1);
    const RawPeer peer = RawPeer::connectTo(path("local"));
    peer.send(oneWay("once"));
    EXPECT_TRUE(spinUntil([&] { return events == "0:once "; })) << events;
    spinOnce();
    EXPECT_EQ(events, "0:once ");
}

TEST_F(LocalPortTest, CannotBeMadeInARefusedDirectory)
{
    const EnvironmentVariable refused("PELORUS_PORT_DIRECTORY", "/proc/self/status");
    const auto made = platform.createLocalMessagePort("local", note());
    EXPECT_FALSE(made.port);
    EXPECT_FALSE(made.alreadyExisted);
    EXPECT_FALSE(platform.createLocalMessagePort("a/b", note()).port);
}

TEST_F(LocalPortTest, InvalidationClosesAndIsSaidOnce)
{
    const auto port = make(note());
    platform.deliverOnMainQueue(*port);
    const RawPeer peer = RawPeer::connectTo(path("local"));
    peer.send(oneWay("a"));
    ASSERT_TRUE(spinUntil([&] { return events == "0:a "; }));
    platform.setInvalidationCallback(*port, [&](MessagePort& invalid) {
        EXPECT_EQ(&invalid, port.get());
        EXPECT_FALSE(platform.isPortValid(invalid));
        events += "invalidated ";
        platform.invalidatePort(invalid);
    });
    EXPECT_TRUE(platform.isPortValid(*port));
    platform.invalidatePort(*port);
    platform.invalidatePort(*port);
    EXPECT_EQ(events, "0:a invalidated ");
    EXPECT_EQ(peer.receive(1), "");
    EXPECT_NE(::access(path("local").c_str(), F_OK), 0);
    EXPECT_FALSE(platform.isPortValid(*port));
}

TEST_F(LocalPortTest, ClearedInvalidationCallbackIsNotCalled)
{
    const auto port = make(note());
    platform.setInvalidationCallback(*port, [&](MessagePort&) { events += "called"; });
    platform.setInvalidationCallback(*port, nullptr);
    platform.invalidatePort(*port);
    EXPECT_EQ(events, "");
}

TEST_F(LocalPortTest, CallbackMayInvalidateAndReleaseItsPort)
{
    std::shared_ptr<MessagePort> port;
    port = make([&](std::int32_t, std::span<const std::byte> payload) -> std::optional<Bytes> {
        platform.invalidatePort(*port);
        port.reset();
        events += textOf(payload) + " ";
        return Bytes(3);
    });
    platform.setInvalidationCallback(*port, [&](MessagePort&) { events += "invalidated "; });
    platform.deliverOnMainQueue(*port);
    const RawPeer peer = RawPeer::connectTo(path("local"));
    peer.send(wireFrame(5, 0, 1, 1, "first") + oneWay("second"));
    EXPECT_TRUE(spinUntil([&] { return events == "invalidated first "; })) << events;
    spinOnce();
    EXPECT_EQ(events, "invalidated first ");
    EXPECT_EQ(peer.receive(1), "");
}

TEST_F(LocalPortTest, SameNameCanBeTakenAgainInsideTheInvalidationCallback)
{
    std::shared_ptr<MessagePort> port = make(note());
    platform.setInvalidationCallback(*port, [&](MessagePort&) {
        port = make(note());
        platform.deliverOnMainQueue(*port);
    });
    platform.invalidatePort(*port);
    const RawPeer peer = RawPeer::connectTo(path("local"));
    peer.send(oneWay("again"));
    EXPECT_TRUE(spinUntil([&] { return events == "0:again "; }));
}

TEST_F(LocalPortTest, HundredThousandMessagesArriveInOrderAndTimersGoOnMeanwhile)
{
    std::uint32_t received = 0;
    bool inOrder = true;
    const auto port = make([&](std::int32_t, std::span<const std::byte> payload) -> std::optional<Bytes> {
        std::uint32_t number = 0;
        std::memcpy(&number, payload.data(), sizeof number);
        inOrder = inOrder && number == received && payload.size() == 60 + number % 140;
        ++received;
        return std::nullopt;
    });
    platform.deliverOnMainQueue(*port);
    const pid_t child = ::fork();
    if (child == 0) {
        const RawPeer peer = RawPeer::connectTo(path("local"));
        bool sent = true;
        std::string batch;
        for (std::uint32_t number = 0; number < 100000; ++number) {
            std::string payload(60 + number % 140, 'm');
            std::memcpy(payload.data(), &number, sizeof number);
            batch += oneWay(payload);
            if (number % 37 == 36 || number == 99999) {
                sent = sent && peer.send(batch);
                batch.clear();
            }
        }
        ::_exit(sent ? 0 : 1); // closes at once
    }
    int ticksMeanwhile = 0;
    const auto timer = platform.scheduleRepeatingTimer(
        Seconds(0.001), [&] { ticksMeanwhile += received > 0 && received < 100000; });
    EXPECT_TRUE(spinUntil([&] { return received == 100000; })) << received;
    EXPECT_TRUE(inOrder);
    EXPECT_GT(ticksMeanwhile, 0);
    int status = 0;
    ::waitpid(child, &status, 0);
    EXPECT_EQ(status, 0);
}

} // namespace pelorus
