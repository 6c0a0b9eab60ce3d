#include "tests/modem/ModemFixture.h"

namespace pelorus {

using namespace test;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;

namespace {

class ModemPresenceTest : public ModemFixture {};

} // namespace

TEST_F(ModemPresenceTest, WaitsForAModemWithoutAskingAgainAndAgain)
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

TEST_F(ModemPresenceTest, ModemThatVanishesAndComesBackUnderAnotherPath)
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

TEST_F(ModemPresenceTest, ModemManagerThatComesAndRestarts)
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

TEST_F(ModemPresenceTest, AnswerThatNeverComesAtTheStartIsAskedForAgain)
{
    fake->appear();
    plugIn();
    fake->answers["GetManagedObjects"].silent = true;
    serve();
    ASSERT_TRUE(spinUntil([&] { return fake->count("ObjectManager.GetManagedObjects()") == 2; }));
    fake->answers.clear();
    EXPECT_TRUE(reachable());
}

TEST_F(ModemPresenceTest, OfSeveralTheOneThatIsNamed)
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

TEST_F(ModemPresenceTest, SignalsOfOthersAreNotBelieved)
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

TEST_F(ModemPresenceTest, ModemThatIsNeitherOfLteNorOfGsmIsRefused)
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

TEST_F(ModemPresenceTest, BusThatIsNotThereIsWaitedForAndOneThatGoesIsFoundAgain)
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
