#include "tests/model/ModelFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class ChannelLoss : public ModelFixture {
protected:
    ChannelLoss() { startWith("Osprey LTE"); }
};

TEST_F(ChannelLoss, InvalidatedLocalPortRestartsAtOnce)
{
    const auto lost = platform.localPort();
    const auto moment = platform.elapsed;
    platform.breakPort(*lost);
    const auto lines = errors();
    ASSERT_GE(lines.size(), 2U);
    EXPECT_EQ(lines[0], " ***** INVALIDATED %p *****");
    EXPECT_EQ(lines[1], " ***** Created ports (send=%p, recv=%p)");
    EXPECT_EQ(lines.back(), "Starting the display update timer");
    EXPECT_TRUE(started());
    EXPECT_TRUE(model->isConnected());
    EXPECT_NE(platform.localPort(), lost);
    EXPECT_EQ(platform.elapsed, moment);
}

TEST_F(ChannelLoss, NamesTheInvalidatedPort)
{
    const auto lost = platform.localPort();
    platform.breakPort(*lost);
    EXPECT_EQ(log.take().front(),
              "<3> ***** INVALIDATED " + fmt::sprintf("%p", static_cast<const void*>(lost.get())) + " *****");
}

TEST_F(ChannelLoss, RestartThatFailsIsTriedAgainFiveSecondsLater)
{
    platform.serverPresent = false;
    platform.breakPort(*platform.localPort());
    EXPECT_THAT(errors(), ElementsAre(" ***** INVALIDATED %p *****", "Could not create HXServerConnection",
                                      "Could not create the ports necessary"));
    platform.serverPresent = true;
    platform.advance(4999ms);
    EXPECT_FALSE(started());
    platform.advance(1ms);
    EXPECT_TRUE(started());
}

TEST_F(ChannelLoss, BrokenSendPortIsNoticedByTheNextRefresh)
{
    platform.breakPort(*platform.remotePort());
    EXPECT_THAT(log.take(), IsEmpty());
    platform.advance(1999ms);
    EXPECT_THAT(log.take(), IsEmpty());
    platform.calls.clear();
    platform.advance(1ms);
    const auto lines = errors();
    EXPECT_EQ(lines.front(), " ***** INVALIDATED %p *****");
    EXPECT_EQ(lines.back(), "Starting the display update timer");
    EXPECT_EQ(platform.calls.front(), "invalidatePort io.pelorus.BasebandStateReport.LogChannel");
    EXPECT_TRUE(started());
    EXPECT_TRUE(model->isConnected());
}

TEST_F(ChannelLoss, RefreshThatRestartsAnnouncesItsNewDataAllTheSame)
{
    platform.deliver(simFiles("8949"));
    platform.breakPort(*platform.remotePort());
    platform.advance(2s);
    EXPECT_EQ(observer.updates, 1);
}

TEST_F(ChannelLoss, TearingDownNeverRestarts)
{
    const auto recvPort = platform.localPort();
    model->destroyPorts();
    EXPECT_FALSE(recvPort->valid);
    EXPECT_THAT(log.take(), IsEmpty());
    EXPECT_FALSE(started());
    platform.advance(60s);
    EXPECT_FALSE(started());
}

TEST_F(ChannelLoss, CallbacksAreClearedBeforeEachPortIsInvalidated)
{
    platform.calls.clear();
    model->destroyPorts();
    EXPECT_THAT(platform.calls,
                ElementsAre("clearInvalidationCallback io.pelorus.BasebandStateReport.LogChannel",
                            "invalidatePort io.pelorus.BasebandStateReport.LogChannel",
                            "clearInvalidationCallback io.pelorus.ScriptedRemotePort",
                            "invalidatePort io.pelorus.ScriptedRemotePort"));
}

TEST_F(ChannelLoss, StateAndHistorySurvive)
{
    platform.deliver(simFiles("8949"));
    platform.advance(2s);
    model->topLevelNodes();
    ASSERT_EQ(model->getSaveContents()->elements.size(), 2U); // the history entry and the DLF file

    platform.breakPort(*platform.localPort());
    EXPECT_EQ(model->getSaveContents()->elements.size(), 2U);
    platform.deliver(std::string_view("short"));
    platform.advance(2s);
    EXPECT_EQ(shownAt("/SIM Info/EF-ICCID"), "8949");
    EXPECT_EQ(model->getSaveContents()->elements.size(), 3U);
}

TEST_F(ChannelLoss, WhatNoRefreshCameForIsInTheHistory)
{
    const Bytes message = simFiles("8949");
    platform.deliver(message);
    platform.breakPort(*platform.localPort());
    ASSERT_TRUE(started());
    const auto saved = model->getSaveContents();
    ASSERT_EQ(saved->elements.size(), 2U);
    EXPECT_EQ(saved->elements[0].dictionary()->at("DisplayState"), Value(makeData(message)));

    platform.breakPort(*platform.localPort());
    EXPECT_EQ(model->getSaveContents()->elements.size(), 2U) << "only once";
}

TEST_F(ChannelLoss, NewGeneratorGoesOnInTheSameDisplay)
{
    platform.deliver(simFiles("8949"));
    platform.breakPort(*platform.localPort());
    platform.deliver(simFiles("8950"));
    platform.advance(2s);
    EXPECT_EQ(shownAt("/SIM Info/EF-ICCID"), "8950");
}

TEST_F(ChannelLoss, ObserverHearsOfEveryChange)
{
    platform.runMainQueue();
    EXPECT_EQ(observer.connectionChanges, 1);

    platform.serverPresent = false;
    platform.breakPort(*platform.localPort());
    EXPECT_EQ(observer.connectionChanges, 1); // not from within the port's callback
    platform.runMainQueue();
    EXPECT_EQ(observer.connectionChanges, 2);
    EXPECT_FALSE(model->isConnected());

    platform.advance(10s); // two more failures are no change
    EXPECT_EQ(observer.connectionChanges, 2);

    platform.serverPresent = true;
    platform.advance(5s);
    EXPECT_EQ(observer.connectionChanges, 3);
    EXPECT_TRUE(model->isConnected());
}

} // namespace
} // namespace pelorus::test
