#include "tests/modem/ModemFixture.h"

namespace pelorus {

using namespace test;
using namespace std::chrono_literals;
using testing::ElementsAre;

namespace {

class ModemFeedTest : public ModemFixture {};

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

} // namespace pelorus
