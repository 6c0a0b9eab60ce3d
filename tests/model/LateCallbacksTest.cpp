#include "tests/model/ModelFixture.h"

namespace pelorus::test {
namespace {

using testing::IsEmpty;

/// What was under way when the model ended comes too late and does nothing.
class LateCallbacks : public ModelFixture {};

TEST_F(LateCallbacks, ScheduledRetry)
{
    platform.serverPresent = false;
    model->startMonitor();
    model.reset();
    platform.calls.clear();
    platform.advance(60s);
    EXPECT_THAT(platform.calls, IsEmpty());
}

TEST_F(LateCallbacks, QueuedViewUpdate)
{
    startWith("Osprey LTE");
    platform.runMainQueue();
    platform.deliver(simFiles("1"));
    model->refresh();
    model.reset();
    platform.runMainQueue();
    EXPECT_EQ(observer.updates, 0);
    EXPECT_EQ(observer.connectionChanges, 1);
}

TEST_F(LateCallbacks, QueuedConnectionChange)
{
    startWith("Osprey LTE");
    model.reset();
    platform.runMainQueue();
    EXPECT_EQ(observer.connectionChanges, 0);
}

TEST_F(LateCallbacks, MessageOnAPortThatLivesOn)
{
    startWith("Osprey LTE");
    const auto port = platform.localPort();
    model.reset();
    log.take();
    EXPECT_EQ(port->message(0, {}), std::nullopt);
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(LateCallbacks, InvalidationThatWasUnderWay)
{
    startWith("Osprey LTE");
    const auto port = platform.localPort();
    const auto callback = port->invalidation;
    model.reset();
    log.take();
    callback(*port);
    EXPECT_EQ(withoutAddresses(log.take().at(0)), "<3> ***** INVALIDATED %p *****");
    EXPECT_FALSE(started());
}

TEST_F(LateCallbacks, EndOfTheModelClosesPortsAndTimer)
{
    startWith("Osprey LTE");
    const auto recvPort = platform.localPort();
    const auto sendPort = platform.remotePort();
    model.reset();
    EXPECT_FALSE(recvPort->valid);
    EXPECT_FALSE(sendPort->valid);
    EXPECT_EQ(platform.repeatingTimers(), 0U);
}

} // namespace
} // namespace pelorus::test
