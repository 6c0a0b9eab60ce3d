#include "tests/model/ModelFixture.h"

namespace pelorus::test {
namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;

class StartMonitor : public ModelFixture {};

TEST_F(StartMonitor, SendsTheStartCommandAndAwaitsNoReply)
{
    model->startMonitor();
    ASSERT_EQ(platform.sent.size(), 2U);
    const SentMessage& command = platform.sent[1];
    EXPECT_EQ(command.port, "io.pelorus.ScriptedRemotePort");
    EXPECT_EQ(command.id, 0);
    EXPECT_EQ(command.sendTimeout, Seconds(1.0));
    EXPECT_EQ(command.receiveTimeout, Seconds(0.0));
    const std::string text(reinterpret_cast<const char*>(command.payload.data()), command.payload.size());
    EXPECT_EQ(text.substr(0, 5), "<?xml");
    EXPECT_EQ(command.propertyList().dictionary()->at("SetState"), Value("Streaming"));
}

TEST_F(StartMonitor, StartCommandCannotBeSent)
{
    platform.oneWayStatus = -3;
    model->startMonitor();
    const auto lines = errors();
    ASSERT_GE(lines.size(), 2U);
    EXPECT_EQ(lines[lines.size() - 2], "Got log generated: %p");
    EXPECT_EQ(lines.back(), " ***** Could not send the START command (got error=-3)");
    EXPECT_FALSE(started());
    EXPECT_FALSE(model->isConnected());

    platform.oneWayStatus = 0;
    platform.advance(4999ms);
    EXPECT_FALSE(started());
    platform.advance(1ms);
    EXPECT_TRUE(started());
    EXPECT_EQ(errors().back(), "Starting the display update timer");
}

TEST_F(StartMonitor, DoesNothingOnceStarted)
{
    startWith("Osprey LTE");
    platform.calls.clear();
    model->startMonitor();
    EXPECT_THAT(platform.calls, IsEmpty());
    EXPECT_THAT(log.take(), IsEmpty());
    EXPECT_EQ(platform.repeatingTimers(), 1U);
}

TEST_F(StartMonitor, ScheduledRetryDoesNothingWhenStartedMeanwhile)
{
    platform.serverPresent = false;
    model->startMonitor();
    platform.serverPresent = true;
    platform.advance(1s);
    model->restartMonitor();
    log.take();
    platform.calls.clear();
    platform.advance(4s);
    EXPECT_THAT(platform.calls, IsEmpty());
    EXPECT_EQ(platform.repeatingTimers(), 1U);
}

TEST_F(StartMonitor, RetryComesFiveSecondsAfterAFailureThatTookTime)
{
    platform.sendDuration = 1s;
    platform.answerTechnology("Osprey 5G");
    model->startMonitor(); // fails at 1 s
    platform.advance(4999ms);
    EXPECT_EQ(platform.sent.size(), 1U);
    platform.advance(1ms);
    EXPECT_EQ(platform.sent.size(), 2U);
    EXPECT_EQ(platform.sent[1].when, 6s);
}

TEST_F(StartMonitor, TimerTicksEveryTwoSeconds)
{
    startWith("Osprey LTE");
    for (int tick = 1; tick <= 3; ++tick) {
        platform.deliver(simFiles("1"));
        platform.advance(1999ms);
        EXPECT_EQ(observer.updates, tick - 1);
        platform.advance(1ms);
        EXPECT_EQ(observer.updates, tick);
    }
}

TEST_F(StartMonitor, RestartTearsDownAndStartsAgain)
{
    startWith("Osprey LTE");
    platform.calls.clear();
    model->restartMonitor();
    EXPECT_TRUE(started());
    EXPECT_TRUE(model->isConnected());
    platform.calls.resize(5);
    EXPECT_THAT(platform.calls,
                ElementsAre("clearInvalidationCallback io.pelorus.BasebandStateReport.LogChannel",
                            "invalidatePort io.pelorus.BasebandStateReport.LogChannel",
                            "clearInvalidationCallback io.pelorus.ScriptedRemotePort",
                            "invalidatePort io.pelorus.ScriptedRemotePort",
                            "createLocalMessagePort io.pelorus.BasebandStateReport.LogChannel"));
}

TEST_F(StartMonitor, UTRANWithoutATemplateStartsWithNothingToAskFor)
{
    startWith("Osprey UTRAN2");
    EXPECT_TRUE(started());
    const Value command = platform.sent.at(1).propertyList();
    EXPECT_EQ(command, Value(makeDictionary({{"SetState", "Streaming"},
                                             {"SetOspreyLogCodes", makeArray()},
                                             {"SetCtExtraCodes", makeArray()}})));
}

TEST_F(StartMonitor, DestroyPortsOnAnIdleModelIsHarmless)
{
    model->destroyPorts();
    model->destroyPorts();
    platform.runMainQueue();
    EXPECT_THAT(platform.calls, IsEmpty());
    EXPECT_THAT(log.take(), IsEmpty());
    EXPECT_EQ(observer.connectionChanges, 0);
    EXPECT_FALSE(model->isConnected());
}

TEST_F(StartMonitor, DestroyPortsEndsTheTimer)
{
    startWith("Osprey LTE");
    model->destroyPorts();
    EXPECT_EQ(platform.repeatingTimers(), 0U);
    EXPECT_FALSE(model->isConnected());
    EXPECT_EQ(platform.localPort(), nullptr);
    EXPECT_EQ(platform.remotePort(), nullptr);
}

} // namespace
} // namespace pelorus::test
