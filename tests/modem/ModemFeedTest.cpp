#include "tests/modem/ModemFixture.h"

namespace pelorus {

using namespace test;
using namespace std::chrono_literals;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;

namespace {

class ModemFeedTest : public ModemFixture {};

QVariantMap lteCell(bool serving, const char* identity, unsigned earfcn)
{
    return {{"cell-type", 5U}, {"serving", serving}, {"physical-ci", identity}, {"earfcn", earfcn}};
}

} // namespace

TEST_F(ModemFeedTest, ShowsTheServingCellWithoutCellInfo)
{
    fake->appear();
    plugIn();
    answerLocation("262,01,0,124A30B,2B0C");
    fake->answers["GetCellInfo"] = {{}, "org.freedesktop.ModemManager1.Error.Core.Unsupported"};
    serve();
    ASSERT_TRUE(reachable());
    EXPECT_EQ(technologies.back(), "Osprey LTE");
    const auto monitor = client();
    EXPECT_TRUE(
        showsSoon(*monitor, 1,
                  "[{CellMonitorCellRadioAccessTechnology: CellMonitorRadioAccessTechnologyLTE, "
                  "CellMonitorCellType: CellMonitorCellTypeServing, CellMonitorMCC: 262, CellMonitorMNC: 1, "
                  "CellMonitorTAC: 11020, CellMonitorCellId: 19178251, CellMonitorBandInfo: 3, "
                  "CellMonitorRSCP: -95, CellMonitorECN0: -10}]"));
    EXPECT_TRUE(showsSoon(*monitor, 0,
                          "{kSimFile_ICCID: 89490100001234567897, kSimFile_MSISDN: +491713920012, "
                          "kSimFile_AHPLMN: 26201, kSimFile_RATMODE: LTE, kSimFile_PNN: Test Network}"));
    EXPECT_TRUE(showsSoon(*monitor, 2, "[]"));
    fake->change(kModemPath, kSignalInterface, {{"Lte", QVariantMap{{"rsrp", -101.0}}}});
    EXPECT_TRUE(showsSoon(*monitor, 1, "CellMonitorRSCP: -101}]"));
}

TEST_F(ModemFeedTest, CallThatIsUnsupportedIsMadeOnce)
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

TEST_F(ModemFeedTest, CellInfoWinsAndBringsNeighbours)
{
    fake->appear();
    plugIn();
    answerLocation("262,01,0,124A30B,2B0C");
    answerCells({lteCell(false, "1F7", 6300), lteCell(true, "1A0", 1300)});
    serve();
    ASSERT_TRUE(reachable());
    const auto monitor = client({1});
    EXPECT_TRUE(showsSoon(
        *monitor, 1,
        "CellMonitorCellType: CellMonitorCellTypeServing, CellMonitorPID: 416, CellMonitorBandInfo: 3, "
        "CellMonitorUARFCN: 1300, CellMonitorMCC: 262, CellMonitorMNC: 1, CellMonitorTAC: 11020, "
        "CellMonitorCellId: 19178251, CellMonitorRSCP: -95, CellMonitorECN0: -10}"
        "{CellMonitorCellRadioAccessTechnology: CellMonitorRadioAccessTechnologyLTE, "
        "CellMonitorCellType: CellMonitorCellTypeNeighbor, CellMonitorPID: 503, CellMonitorBandInfo: 20, "
        "CellMonitorUARFCN: 6300, CellMonitorRSCP: 32767, CellMonitorECN0: 32767}]"));
    EXPECT_EQ(count(*monitor, 0) + count(*monitor, 2), 0) << "it was not asked for";
}

TEST_F(ModemFeedTest, WaitsForAModemWithoutAskingAgainAndAgain)
{
    fake->appear();
    serve();
    ASSERT_TRUE(spinUntil([&] { return linesWith("ModemManager has no modem; waiting for one") == 1; }));
    TestClient early("early");
    EXPECT_EQ(early.createChannel(), 2);
    EXPECT_EQ(early.createChannel(), 2);
    EXPECT_EQ(linesWith("no channel (error 2): ModemManager has no modem; waiting for one"), 1);
    const auto asked = fake->calls.size();
    EXPECT_EQ(asked, 1U);
    plugIn();
    ASSERT_TRUE(reachable());
    EXPECT_EQ(early.createChannel(), 0);
    EXPECT_EQ(fake->count("ObjectManager.GetManagedObjects()"), 1);
}

TEST_F(ModemFeedTest, AnotherTechnologyDropsTheChannel)
{
    fake->appear();
    plugIn();
    serve();
    ASSERT_TRUE(reachable());
    const auto monitor = client();
    fake->change(kModemPath, kModemInterface, {{"AccessTechnologies", 0U}}); // out of reach for a moment
    fake->change(kModemPath, kModemInterface, {{"AccessTechnologies", 1U << 14 | 1U << 15}});
    spinOnce();
    EXPECT_TRUE(monitor->isOpen());
    fake->change(kModemPath, kModemInterface, {{"AccessTechnologies", 1U << 5}});
    ASSERT_TRUE(spinUntil([&] { return monitor->portClosed && monitor->commandsClosed; }));
    EXPECT_THAT(technologies, ElementsAre("Osprey LTE", "Osprey GSM"));
    fake->change(kModemPath, kSignalInterface, {{"Umts", QVariantMap{{"rscp", -82.0}, {"ecio", -6.0}}}});
    const auto again = client();
    EXPECT_TRUE(showsSoon(*again, 1, "CellMonitorRadioAccessTechnologyUMTS"));
    EXPECT_TRUE(showsSoon(*again, 1, "CellMonitorRSCP: -82, CellMonitorECN0: -6"));
    fake->change(kModemPath, kModemInterface, {{"AccessTechnologies", 1U << 1}});
    EXPECT_TRUE(showsSoon(*again, 1, "CellMonitorRadioAccessTechnologyGSM"));
    EXPECT_TRUE(again->isOpen()) << "that is one technology";
}

TEST_F(ModemFeedTest, ModemThatVanishesAndComesBackUnderAnotherPath)
{
    fake->appear();
    plugIn();
    serve();
    ASSERT_TRUE(reachable());
    const auto monitor = client();
    fake->remove(kModemPath, fake->objects[kModemPath].keys());
    ASSERT_TRUE(spinUntil([&] { return monitor->portClosed; }));
    EXPECT_EQ(technologies.back(), "");
    TestClient other("other");
    EXPECT_EQ(other.createChannel(), 2);
    plugIn("/org/freedesktop/ModemManager1/Modem/1");
    ASSERT_TRUE(reachable());
    EXPECT_TRUE(showsSoon(*client(), 0, "89490100001234567897"));
}

TEST_F(ModemFeedTest, ModemManagerThatComesAndRestarts)
{
    serve();
    ASSERT_TRUE(spinUntil([&] { return linesWith("ModemManager does not run") == 1; }));
    TestClient early("early");
    EXPECT_EQ(early.createChannel(), 2);
    fake->appear();
    plugIn();
    ASSERT_TRUE(reachable());
    const auto monitor = client();
    ASSERT_TRUE(spinUntil([&] { return fake->count("Signal.Setup(2)") == 1; }));
    fake->vanish();
    ASSERT_TRUE(spinUntil([&] { return monitor->portClosed; }));
    fake = std::make_unique<FakeModemManager>(privateBus.address()); // the rate is forgotten
    plugIn();
    fake->appear();
    ASSERT_TRUE(reachable());
    const auto again = client();
    EXPECT_TRUE(showsSoon(*again, 0, "89490100001234567897"));
    EXPECT_TRUE(spinUntil([&] { return fake->count("Signal.Setup(2)") == 1; }));
}

TEST_F(ModemFeedTest, LockedSimIsToldOfAndWhatComesWithTheUnlockingIsTaken)
{
    fake->appear();
    plugIn();
    const FakeInterfaces all = fake->objects[kModemPath];
    fake->objects[kModemPath] = {{kModemInterface,
                                  {{"State", 2},
                                   {"AccessTechnologies", 0U},
                                   {"CurrentCapabilities", 12U},
                                   {"DeviceIdentifier", "first"},
                                   {"Sim", QVariant::fromValue(QDBusObjectPath(kSimPath))}}}};
    fake->objects[kSimPath][kSimInterface] = {{"SimIdentifier", ""}, {"Imsi", ""}};
    answerLocation("262,01,0,124A30B,2B0C");
    serve();
    ASSERT_TRUE(reachable());
    EXPECT_EQ(technologies.back(), "Osprey LTE") << "by what it is able to";
    EXPECT_EQ(linesWith("is locked: its SIM needs a PIN"), 1);
    const auto monitor = client();
    EXPECT_TRUE(showsSoon(*monitor, 0, "{kSimFile_ICCID: , kSimFile_MSISDN: "));
    EXPECT_TRUE(showsSoon(*monitor, 1, "[]"));
    EXPECT_EQ(fake->count("Modem.GetCellInfo()"), 0) << "it is not enabled";
    fake->change(kSimPath, kSimInterface, {{"SimIdentifier", "89490100001234567897"}});
    for (const QString& late : {kModem3gppInterface, kSignalInterface, kLocationInterface})
        fake->add(kModemPath, {{late, all[late]}});
    fake->change(kModemPath, kModemInterface, all[kModemInterface]);
    EXPECT_TRUE(showsSoon(*monitor, 0, "kSimFile_ICCID: 89490100001234567897"));
    EXPECT_TRUE(showsSoon(*monitor, 1, "CellMonitorTAC: 11020"));
}

TEST_F(ModemFeedTest, BearerThatConnects)
{
    fake->appear();
    plugIn();
    fake->add(kBearerPath,
              {{kBearerInterface,
                {{"Connected", false},
                 {"Properties",
                  QVariantMap{{"apn", "internet.example"}, {"ip-type", 1U}, {"password", "secret"}}}}}});
    serve();
    ASSERT_TRUE(reachable());
    const auto monitor = client({2});
    EXPECT_TRUE(showsSoon(*monitor, 2, "[]"));
    fake->change(kModemPath, kModemInterface,
                 {{"Bearers", QVariant::fromValue(QList<QDBusObjectPath>{QDBusObjectPath(kBearerPath)})}});
    EXPECT_TRUE(
        showsSoon(*monitor, 2, "[{Context ID: 3, APN: internet.example, PDP Type: IPv4, State: Inactive}]"));
    fake->change(kBearerPath, kBearerInterface,
                 {{"Connected", true},
                  {"Interface", "wwan0"},
                  {"Ip4Config", QVariantMap{{"address", "192.0.2.37"}}},
                  {"Stats", QVariantMap{{"duration", 1U}, {"rx-bytes", 7ULL}, {"tx-bytes", 9ULL}}}});
    EXPECT_TRUE(
        showsSoon(*monitor, 2,
                  "State: Active, Interface: wwan0, IPv4 Address: 192.0.2.37, Duration: 1 s, Bytes In: 7, "
                  "Bytes Out: 9}]"));
}

TEST_F(ModemFeedTest, UnchangedListsAreRepeatedInTheirTimeAndNotBefore)
{
    fake->appear();
    plugIn();
    serve();
    ASSERT_TRUE(reachable());
    const auto monitor = client({0});
    ASSERT_TRUE(showsSoon(*monitor, 0, "Test Network"));
    const auto first = std::chrono::steady_clock::now();
    const int before = count(*monitor, 0);
    ASSERT_TRUE(spinUntil([&] { return count(*monitor, 0) == before + 1; }));
    EXPECT_GE(std::chrono::steady_clock::now() - first, 350ms);
    EXPECT_GE(fake->calls.size(), 2U);
}

TEST_F(ModemFeedTest, NothingIsPolledForNobodyOrForWhatNobodyAskedFor)
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

TEST_F(ModemFeedTest, SignalRateIsRaisedForAListenerAndPutBack)
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

TEST_F(ModemFeedTest, SignalRateThatWillDoIsLeftAlone)
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

TEST_F(ModemFeedTest, SignalRateThatAnotherProgramChangedIsNotPutBack)
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

TEST_F(ModemFeedTest, LocationIsTurnedOnBesideWhatIsOnAndOffAgain)
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

TEST_F(ModemFeedTest, RefusalsAreSaidOnceAndTriedAgain)
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

TEST_F(ModemFeedTest, CallsThatNeverReturnHoldUpNothingElse)
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

TEST_F(ModemFeedTest, AnswerThatNeverComesAtTheStartIsAskedForAgain)
{
    fake->appear();
    plugIn();
    fake->answers["GetManagedObjects"].silent = true;
    serve();
    ASSERT_TRUE(spinUntil([&] { return fake->count("ObjectManager.GetManagedObjects()") == 2; }));
    fake->answers.clear();
    EXPECT_TRUE(reachable());
}

TEST_F(ModemFeedTest, OfSeveralTheOneThatIsNamed)
{
    fake->appear();
    plugIn();
    FakeInterfaces second = lteModem();
    second[kModemInterface]["DeviceIdentifier"] = "second";
    second[kModemInterface]["AccessTechnologies"] = 1U << 3;
    serve("second");
    ASSERT_TRUE(spinUntil(
        [&] { return linesWith("ModemManager has no modem second, only first; waiting for it") == 1; }));
    fake->add("/org/freedesktop/ModemManager1/Modem/7", second);
    ASSERT_TRUE(reachable());
    EXPECT_EQ(technologies.back(), "Osprey GSM");
}

TEST_F(ModemFeedTest, SignalsOfOthersAreNotBelieved)
{
    fake->appear();
    plugIn();
    serve();
    ASSERT_TRUE(reachable());
    FakeModemManager impostor(privateBus.address());
    impostor.change(kModemPath, kModemInterface, {{"AccessTechnologies", 2U}});
    impostor.remove(kModemPath, {kModemInterface});
    FakeInterfaces other = lteModem();
    impostor.add("/org/freedesktop/ModemManager1/Modem/5", other);
    spinOnce();
    spinOnce();
    EXPECT_THAT(technologies, ElementsAre("Osprey LTE"));
}

TEST_F(ModemFeedTest, ModemThatIsNeitherOfLteNorOfGsmIsRefused)
{
    fake->appear();
    plugIn();
    fake->objects[kModemPath][kModemInterface]["AccessTechnologies"] = 1U << 10;
    fake->objects[kModemPath][kModemInterface]["CurrentCapabilities"] = 2U;
    serve();
    ASSERT_TRUE(spinUntil([&] { return linesWith("Thin air") == 1; }));
    TestClient monitor("client");
    EXPECT_EQ(monitor.createChannel(), 2);
    EXPECT_THAT(lines, Contains(HasSubstr("the modem is neither of LTE nor of GSM and UMTS")));
}

TEST_F(ModemFeedTest, BusThatIsNotThereIsWaitedForAndOneThatGoesIsFoundAgain)
{
    fake.reset();
    privateBus.stop();
    serve();
    ASSERT_TRUE(spinUntil([&] { return linesWith("the system bus cannot be reached") >= 1; }));
    TestClient early("early");
    EXPECT_EQ(early.createChannel(), 2);
    privateBus.start();
    fake = std::make_unique<FakeModemManager>(privateBus.address());
    plugIn();
    fake->appear();
    ASSERT_TRUE(reachable());
    const auto monitor = client();
    fake.reset();
    privateBus.stop();
    ASSERT_TRUE(spinUntil([&] { return monitor->portClosed; }));
    privateBus.start();
    fake = std::make_unique<FakeModemManager>(privateBus.address());
    plugIn();
    fake->appear();
    ASSERT_TRUE(reachable());
    EXPECT_TRUE(showsSoon(*client(), 0, "Test Network"));
}

} // namespace pelorus
