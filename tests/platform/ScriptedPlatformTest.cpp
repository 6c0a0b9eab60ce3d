#include "platform/scripted/ScriptedPlatform.h"

#include <gmock/gmock.h>

namespace pelorus {

using namespace std::chrono_literals;
using testing::ElementsAre;

TEST(ScriptedPlatform, AdvanceRunsWhatIsDueInTheOrderOfTime)
{
    ScriptedPlatform platform;
    std::string order;
    platform.dispatchAfterOnMain(3s, [&] { order += 'd'; });
    platform.dispatchAfterOnMain(1s, [&] {
        order += 'b';
        platform.dispatchAsyncOnMain([&] { order += 'c'; });
    });
    platform.dispatchAsyncOnMain([&] { order += 'a'; });
    EXPECT_EQ(order, "");
    EXPECT_EQ(platform.waitingClosures(), 3u);
    platform.runMainQueue();
    EXPECT_EQ(order, "a");
    platform.advance(2999ms);
    EXPECT_EQ(order, "abc");
    platform.advance(1ms);
    EXPECT_EQ(order, "abcd");
    EXPECT_EQ(platform.elapsed, 3s);
}

TEST(ScriptedPlatform, TimerTicksAtItsIntervalUntilInvalidated)
{
    ScriptedPlatform platform;
    std::vector<std::int64_t> ticks;
    std::unique_ptr<RepeatingTimer> timer;
    timer = platform.scheduleRepeatingTimer(2s, [&] {
        ticks.push_back(platform.elapsed / 1s);
        if (ticks.size() == 3)
            timer->invalidate();
    });
    EXPECT_EQ(platform.repeatingTimers(), 1u);
    platform.advance(5s);
    EXPECT_THAT(ticks, ElementsAre(2, 4));
    platform.advance(10s);
    EXPECT_THAT(ticks, ElementsAre(2, 4, 6));
    EXPECT_EQ(platform.repeatingTimers(), 0u);
}

TEST(ScriptedPlatform, TimerMayOutliveThePlatformAndEndInItsOwnTick)
{
    auto platform = std::make_unique<ScriptedPlatform>();
    std::unique_ptr<RepeatingTimer> timer;
    timer = platform->scheduleRepeatingTimer(1s, [&] { timer.reset(); });
    platform->advance(5s);
    EXPECT_FALSE(timer);
    timer = platform->scheduleRepeatingTimer(1s, [] {});
    platform.reset();
    timer->invalidate();
}

TEST(ScriptedPlatform, BlockingSendMovesTheClockAndMissedTicksAreOne)
{
    ScriptedPlatform platform;
    platform.sendDuration = 7s;
    const auto port = platform.createRemoteMessagePort("far");
    int ticks = 0;
    const auto timer = platform.scheduleRepeatingTimer(2s, [&] { ++ticks; });
    platform.sendPortRequest(*port, 0, {}, Seconds(1), Seconds(0));
    EXPECT_EQ(platform.elapsed, 7s);
    EXPECT_EQ(ticks, 0) << "the thread was blocked";
    platform.advance(0s);
    EXPECT_EQ(ticks, 1);
    platform.advance(1s);
    EXPECT_EQ(ticks, 2);
}

TEST(ScriptedPlatform, PortsDoAsTold)
{
    ScriptedPlatform platform;
    std::vector<std::int32_t> ids;
    auto made = platform.createLocalMessagePort(
        "near", [&](std::int32_t id, std::span<const std::byte>) -> std::optional<Bytes> {
            ids.push_back(id);
            return Bytes(2);
        });
    EXPECT_FALSE(platform.deliver("early"));
    platform.deliverOnMainQueue(*made.port);
    EXPECT_TRUE(platform.deliver("message", 5));
    EXPECT_EQ(platform.lastReply, Bytes(2));
    int invalidations = 0;
    platform.setInvalidationCallback(*made.port, [&](MessagePort&) { ++invalidations; });
    platform.invalidatePort(*made.port);
    platform.invalidatePort(*made.port);
    EXPECT_EQ(invalidations, 1);
    EXPECT_FALSE(platform.isPortValid(*made.port));
    EXPECT_FALSE(platform.deliver("late"));
    EXPECT_THAT(ids, ElementsAre(5));
    EXPECT_THAT(platform.calls,
                ElementsAre("createLocalMessagePort near", "deliverOnMainQueue near",
                            "setInvalidationCallback near", "invalidatePort near", "invalidatePort near"));
    platform.localPortExisted = true;
    made = platform.createLocalMessagePort("near", nullptr);
    EXPECT_TRUE(made.port && made.alreadyExisted);
    platform.localPortFails = true;
    EXPECT_FALSE(platform.createLocalMessagePort("near", nullptr).port);
}

TEST(ScriptedPlatform, RecordsWhatIsSentAndAnswersAsTold)
{
    ScriptedPlatform platform;
    platform.answerTechnology("Osprey LTE");
    const auto port = platform.createRemoteMessagePort("far");
    const auto answer = platform.sendPortRequest(*port, 4, {}, Seconds(1), Seconds(2));
    EXPECT_EQ(answer.status, 0);
    EXPECT_EQ(SentMessage{.payload = answer.reply.value()}.propertyList().dictionary()->at("GetTechnology"),
              Value("Osprey LTE"));
    platform.requestAnswer = {-2, std::nullopt};
    EXPECT_EQ(platform.sendPortRequest(*port, 0, {}, Seconds(1), Seconds(1)).status, -2);
    platform.oneWayStatus = -1;
    EXPECT_EQ(platform.sendPortRequest(*port, 0, {}, Seconds(1), Seconds(0)).status, -1);
    ASSERT_EQ(platform.sent.size(), 3u);
    EXPECT_EQ(platform.sent[0].id, 4);
    EXPECT_EQ(platform.sent[0].port, "far");
    EXPECT_EQ(platform.sent[0].receiveTimeout, Seconds(2));
    platform.breakPort(*platform.remotePort());
    EXPECT_EQ(platform.sendPortRequest(*port, 0, {}, Seconds(1), Seconds(0)).status, -3);
}

TEST(ScriptedPlatform, ServerNotifiesWhileItsConnectionLives)
{
    ScriptedPlatform platform;
    int notifications = 0;
    auto connection = platform.createServerConnection([&] { ++notifications; });
    EXPECT_EQ(platform.notifyFromServer(), 1);
    platform.logChannelError = 3;
    EXPECT_EQ(platform.createLogChannel(*connection, "near").error, 3);
    connection.reset();
    EXPECT_EQ(platform.notifyFromServer(), 0);
    EXPECT_EQ(notifications, 1);
    platform.serverPresent = false;
    EXPECT_FALSE(platform.createServerConnection([] {}));
}

TEST(ScriptedPlatform, FilesAndResourcesAreThoseAdded)
{
    ScriptedPlatform platform;
    platform.addResource("LTE", "<plist/>");
    platform.addResource("GSM", "<plist/>");
    EXPECT_EQ(platform.findPropertyListResource("LTE"), "/resources/LTE.plist");
    EXPECT_FALSE(platform.findPropertyListResource("UTRAN"));
    EXPECT_THAT(platform.listPropertyListResources(),
                ElementsAre("/resources/GSM.plist", "/resources/LTE.plist"));
    EXPECT_EQ(platform.readFile("/resources/LTE.plist")->size(), 8u);
    const auto list = makeDictionary({{"Key", "before"}});
    EXPECT_TRUE(platform.writePropertyList(list, "/somewhere"));
    list->set("Key", "after");
    EXPECT_EQ(platform.written.at("/somewhere").dictionary()->at("Key"), Value("before"));
    platform.writesFail = true;
    EXPECT_FALSE(platform.writePropertyList(list, "/elsewhere"));
    EXPECT_FALSE(platform.written.contains("/elsewhere"));
}

TEST(ScriptedPlatform, WallClockMovesWithTheVirtualOne)
{
    ScriptedPlatform platform;
    const std::chrono::system_clock::time_point moment{1'336'123'800s};
    platform.advance(3s);
    platform.setNow(moment);
    EXPECT_EQ(platform.now(), moment);
    platform.advance(5s);
    EXPECT_EQ(platform.now(), moment + 5s);
}

} // namespace pelorus
