#include "tests/modem/ModemFixture.h"

namespace pelorus {

using namespace test;
using namespace std::chrono_literals;
using testing::HasSubstr;

namespace {

class ModemPollingTest : public ModemFixture {};

} // namespace

TEST_F(ModemPollingTest, CallThatIsUnsupportedIsMadeOnce)
{
    fake->appear();
    plugIn();
    fake->answers["GetCellInfo"] = {{}, "org.freedesktop.ModemManager1.Error.Core.Unsupported"};
    serve();
    ASSERT_TRUE(reachable());
    const auto monitor = client();
    ASSERT_TRUE(spinUntil([&] { return fake->count("Location.GetLocation()") >= 5; }));
    EXPECT_EQ(fake->count("Modem.GetCellInfo()"), 1);
    EXPECT_EQ(linesWith("this modem cannot do it"), 1);
}

TEST_F(ModemPollingTest, NothingIsPolledForNobodyOrForWhatNobodyAskedFor)
{
    fake->appear();
    plugIn();
    serve();
    ASSERT_TRUE(reachable());
    const auto monitor = client({0, 2});
    ASSERT_TRUE(showsSoon(*monitor, 0, "Test Network"));
    std::this_thread::sleep_for(150ms);
    spinOnce();
    EXPECT_EQ(fake->count("Modem.GetCellInfo()") + fake->count("Location.GetLocation()"), 0);
    EXPECT_EQ(fake->count("Signal.Setup(2)"), 0);
}

TEST_F(ModemPollingTest, SignalRateIsRaisedForAListenerAndPutBack)
{
    fake->appear();
    plugIn();
    fake->objects[kModemPath][kSignalInterface]["Rate"] = 30U;
    serve();
    ASSERT_TRUE(reachable());
    auto monitor = client();
    ASSERT_TRUE(spinUntil([&] { return fake->count("Signal.Setup(2)") == 1; }));
    monitor.reset();
    ASSERT_TRUE(spinUntil([&] { return fake->count("Signal.Setup(30)") == 1; }));
    const int polled = fake->count("Location.GetLocation()");
    std::this_thread::sleep_for(150ms);
    spinOnce();
    EXPECT_EQ(fake->count("Location.GetLocation()"), polled) << "nobody listens";
    monitor = client();
    ASSERT_TRUE(spinUntil([&] { return fake->count("Signal.Setup(2)") == 2; }));
    bool finished = false;
    feed->finish([&] { finished = true; });
    ASSERT_TRUE(spinUntil([&] { return finished; }));
    EXPECT_EQ(fake->count("Signal.Setup(30)"), 2);
}

TEST_F(ModemPollingTest, SignalRateThatWillDoIsLeftAlone)
{
    fake->appear();
    plugIn();
    fake->objects[kModemPath][kSignalInterface]["Rate"] = 1U;
    serve();
    ASSERT_TRUE(reachable());
    auto monitor = client();
    ASSERT_TRUE(spinUntil([&] { return fake->count("Location.GetLocation()") >= 2; }));
    monitor.reset();
    ASSERT_TRUE(spinUntil([&] { return server->channelCount() == 0; }));
    bool finished = false;
    feed->finish([&] { finished = true; });
    EXPECT_TRUE(spinUntil([&] { return finished; }));
    for (const QString& call : fake->calls)
        EXPECT_THAT(call.toStdString(), testing::Not(HasSubstr("Setup")));
}

TEST_F(ModemPollingTest, SignalRateThatAnotherProgramChangedIsNotPutBack)
{
    fake->appear();
    plugIn();
    serve();
    ASSERT_TRUE(reachable());
    auto monitor = client();
    ASSERT_TRUE(spinUntil([&] { return fake->count("Signal.Setup(2)") == 1; }));
    spinOnce();
    fake->change(kModemPath, kSignalInterface, {{"Rate", 1U}});
    spinOnce();
    monitor.reset();
    ASSERT_TRUE(spinUntil([&] { return server->channelCount() == 0; }));
    spinOnce();
    EXPECT_EQ(fake->count("Signal.Setup(0)"), 0);
}

TEST_F(ModemPollingTest, LocationIsTurnedOnBesideWhatIsOnAndOffAgain)
{
    fake->appear();
    plugIn();
    fake->objects[kModemPath][kLocationInterface]["Capabilities"] = 7U;
    fake->objects[kModemPath][kLocationInterface]["Enabled"] = 4U;
    serve();
    ASSERT_TRUE(reachable());
    auto monitor = client();
    ASSERT_TRUE(spinUntil([&] { return fake->count("Location.Setup(5, false)") == 1; }));
    monitor.reset();
    EXPECT_TRUE(spinUntil([&] { return fake->count("Location.Setup(4, false)") == 1; }));
}

TEST_F(ModemPollingTest, RefusalsAreSaidOnceAndTriedAgain)
{
    fake->appear();
    plugIn();
    fake->answers["GetCellInfo"] = {{}, "org.freedesktop.DBus.Error.AccessDenied"};
    fake->answers["GetLocation"] = {{}, "org.freedesktop.ModemManager1.Error.Core.Unauthorized"};
    fake->answers["Setup"] = {{}, "org.freedesktop.ModemManager1.Error.Core.Unauthorized"};
    serve();
    ASSERT_TRUE(reachable());
    const auto monitor = client();
    ASSERT_TRUE(spinUntil([&] {
        return fake->count("Modem.GetCellInfo()") >= 3 && fake->count("Location.GetLocation()") >= 3 &&
               fake->count("Signal.Setup(2)") >= 3;
    }));
    EXPECT_EQ(linesWith("GetCellInfo failed"), 1);
    EXPECT_EQ(linesWith("the bus policy of ModemManager does not allow it"), 1);
    EXPECT_EQ(linesWith("polkit does not allow it"), 2);
    EXPECT_TRUE(showsSoon(*monitor, 1, "CellMonitorMCC: 262, CellMonitorMNC: 1, CellMonitorBandInfo: 3"));
    answerLocation("262,01,0,124A30B,2B0C");
    answerCells({lteCell(true, "1A0", 1300)});
    EXPECT_TRUE(showsSoon(*monitor, 1, "CellMonitorPID: 416"));
    EXPECT_TRUE(showsSoon(*monitor, 1, "CellMonitorTAC: 11020"));
}

TEST_F(ModemPollingTest, CallsThatNeverReturnHoldUpNothingElse)
{
    fake->appear();
    plugIn();
    answerLocation("262,01,0,124A30B,2B0C");
    fake->answers["GetCellInfo"].silent = true;
    serve();
    ASSERT_TRUE(reachable());
    const auto monitor = client();
    EXPECT_TRUE(showsSoon(*monitor, 1, "CellMonitorTAC: 11020"));
    EXPECT_EQ(fake->count("Modem.GetCellInfo()"), 1);
    ASSERT_TRUE(spinUntil([&] { return fake->count("Location.GetLocation()") >= 4; }));
    EXPECT_EQ(fake->count("Modem.GetCellInfo()"), 1) << "one at a time";
    ASSERT_TRUE(spinUntil([&] { return linesWith("GetCellInfo failed") == 1; })) << "after its time";
    EXPECT_EQ(linesWith("no answer"), 1);
}

} // namespace pelorus
