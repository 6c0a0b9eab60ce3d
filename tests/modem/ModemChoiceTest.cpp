#include "telephonyd/modem/ModemChoice.h"
#include "telephonyd/modem/CallSchedule.h"
#include "telephonyd/modem/ModemErrors.h"

#include <gmock/gmock.h>

namespace pelorus {

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::HasSubstr;

const QString kFirst = "/org/freedesktop/ModemManager1/Modem/9";
const QString kSecond = "/org/freedesktop/ModemManager1/Modem/10"; // came later, though it sorts before

QVariantMap modem(int state, const char* identifier)
{
    return {{"org.freedesktop.ModemManager1.Modem",
             QVariantMap{{"State", state}, {"DeviceIdentifier", identifier}}}};
}

ObjectTree twoModems(int first, int second)
{
    ObjectTree tree;
    tree.replace({{kFirst, modem(first, "first")}, {kSecond, modem(second, "second")}});
    return tree;
}

} // namespace

TEST(ModemChoice, FirstThatIsEnabled)
{
    EXPECT_EQ(chooseModem(twoModems(8, 8), {}, {}), kFirst);
    EXPECT_EQ(chooseModem(twoModems(3, 6), {}, {}), kSecond);
    EXPECT_EQ(chooseModem(twoModems(11, 6), {}, {}), kFirst);
}

TEST(ModemChoice, WithoutAnEnabledOneTheFirstThatHasNotFailed)
{
    EXPECT_EQ(chooseModem(twoModems(2, 3), {}, {}), kFirst);
    EXPECT_EQ(chooseModem(twoModems(-1, 2), {}, {}), kSecond);
    EXPECT_EQ(chooseModem(twoModems(-1, -1), {}, {}), "");
    EXPECT_EQ(chooseModem(ObjectTree(), {}, {}), "");
}

TEST(ModemChoice, TheOneThatIsReadStaysUnlessAnotherIsBetter)
{
    EXPECT_EQ(chooseModem(twoModems(8, 8), {}, kSecond), kSecond);
    EXPECT_EQ(chooseModem(twoModems(8, 3), {}, kSecond), kFirst);
}

TEST(ModemChoice, ByIdentifier)
{
    EXPECT_EQ(chooseModem(twoModems(8, 3), "second", {}), kSecond);
    EXPECT_EQ(chooseModem(twoModems(8, 3), "third", {}), "");
    EXPECT_EQ(whyNoModem(twoModems(8, 3), "third"),
              "ModemManager has no modem third, only first, second; waiting for it");
    EXPECT_EQ(whyNoModem(ObjectTree(), "third"), "ModemManager has no modem; waiting for one");
}

TEST(ModemChoice, SaysWhyAModemFailed)
{
    ObjectTree tree;
    auto failed = modem(-1, "first");
    failed = {{"org.freedesktop.ModemManager1.Modem",
               QVariantMap{{"State", -1}, {"DeviceIdentifier", "first"}, {"StateFailedReason", 2U}}}};
    tree.replace({{kFirst, failed}});
    EXPECT_EQ(whyNoModem(tree, {}), "modem first failed, its SIM is missing");
}

TEST(ObjectTree, ChangesOnlyWhatIsThere)
{
    ObjectTree tree = twoModems(8, 8);
    const QString interface = "org.freedesktop.ModemManager1.Modem";
    tree.change(kFirst, interface, {{"State", 3}});
    tree.change(kFirst, "other", {{"State", 5}});
    tree.change("/nobody", interface, {{"State", 5}});
    EXPECT_EQ(stateOf(tree.properties(kFirst, interface)), 3);
    EXPECT_EQ(tree.properties(kFirst, interface).value("DeviceIdentifier"), "first");
    EXPECT_FALSE(tree.has(kFirst, "other"));
    EXPECT_FALSE(tree.has("/nobody", interface));
    tree.add(kFirst, {{"other", QVariantMap{}}});
    tree.remove(kFirst, {interface});
    EXPECT_THAT(tree.paths(), testing::Contains(kFirst));
    tree.remove(kFirst, {"other", "third"});
    EXPECT_THAT(tree.paths(), ElementsAre(kSecond));
}

TEST(CallSchedule, OneAtATimeWithPauses)
{
    CallSchedule schedule(5s);
    const CallSchedule::Time start{1000s};
    ASSERT_TRUE(schedule.due());
    EXPECT_LE(*schedule.due(), start);
    schedule.started();
    EXPECT_FALSE(schedule.due());
    schedule.succeeded(start);
    EXPECT_EQ(*schedule.due(), start + 5s);
}

TEST(CallSchedule, PausesDoubleUpToFiveMinutesWhileItFails)
{
    CallSchedule schedule(5s);
    const CallSchedule::Time start{1000s};
    std::vector<std::int64_t> pauses;
    for (int i = 0; i < 8; ++i) {
        schedule.started();
        schedule.failed(start);
        pauses.push_back(std::chrono::duration_cast<std::chrono::seconds>(*schedule.due() - start).count());
    }
    EXPECT_THAT(pauses, ElementsAre(10, 20, 40, 80, 160, 300, 300, 300));
    schedule.retryAt(start + 1s);
    EXPECT_EQ(*schedule.due(), start + 1s);
    schedule.succeeded(start);
    schedule.retryAt(start + 1s); // there is nothing to make good
    EXPECT_EQ(*schedule.due(), start + 5s);
}

TEST(CallSchedule, WhatIsImpossibleIsNeverDue)
{
    CallSchedule schedule(5s);
    schedule.started();
    schedule.isImpossible();
    schedule.retryAt(CallSchedule::Time{1000s});
    EXPECT_FALSE(schedule.due());
}

TEST(ModemErrors, BusPolicyAndPolkitAreTwoThings)
{
    EXPECT_EQ(
        explainError("GetCellInfo", "org.freedesktop.DBus.Error.AccessDenied", "Rejected send message"),
        "modem: GetCellInfo failed, neighbour cells and the serving cell's channel are not shown: the bus "
        "policy of ModemManager does not allow it; io.pelorus.telephonyd.conf does (install with "
        "-DPELORUS_INSTALL_BUS_POLICY=ON, then: systemctl reload dbus) "
        "(org.freedesktop.DBus.Error.AccessDenied: Rejected send message)");
    EXPECT_THAT(explainError("GetCellInfo", "org.freedesktop.ModemManager1.Error.Core.Unauthorized", "no"),
                HasSubstr("polkit does not allow it from here"));
    EXPECT_THAT(explainError("GetManagedObjects", "org.freedesktop.DBus.Error.ServiceUnknown", "not there"),
                HasSubstr("ModemManager does not run"));
    EXPECT_THAT(explainError("GetLocation", "org.freedesktop.DBus.Error.NoReply", ""),
                HasSubstr("no answer"));
    EXPECT_THAT(explainError("GetLocation", "com.example.Odd", "odd thing"),
                HasSubstr("com.example.Odd: odd thing"));
}

TEST(Complaints, AreMadeOnceUntilTheyAreOver)
{
    std::vector<std::string> lines;
    Complaints complaints([&](const std::string& line) { lines.push_back(line); });
    complaints.say("one", "a");
    complaints.say("one", "a");
    complaints.say("other", "a");
    complaints.say("one", "b");
    complaints.isOver("one");
    complaints.say("one", "b");
    EXPECT_THAT(lines, ElementsAre("a", "a", "b", "b"));
}

} // namespace pelorus
