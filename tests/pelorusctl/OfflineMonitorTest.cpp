#include "pelorusctl/OfflineMonitor.h"

#include "platform/scripted/ScriptedPlatform.h"

#include <fmt/format.h>
#include <gtest/gtest.h>

namespace pelorus {

using namespace std::chrono_literals;

namespace {

/// Shows the messages since the last refresh, one character each.
class Recorder : public LogGenerator {
public:
    explicit Recorder(Platform& system) : LogGenerator(system) {}

    void updateState(State& state, std::span<const std::byte> data) override
    {
        (void)state;
        for (const std::byte byte : data)
            received += static_cast<char>(byte);
    }
    Value generateLogUsingState(State& state) override
    {
        updateHistoryInState(platform, state);
        return std::exchange(received, {});
    }
    std::shared_ptr<Array> getSaveContentsFromState(const State& state) const override
    {
        return historyOf(state);
    }

private:
    std::string received;
};

} // namespace

class OfflineMonitorTest : public testing::Test {
protected:
    /// Messages named by letters at so many nanoseconds; what each refresh shows as "messages@time ".
    std::string refreshes(std::optional<std::chrono::nanoseconds> every,
                          const std::vector<std::chrono::nanoseconds>& times)
    {
        std::string text;
        OfflineMonitor monitor(std::make_unique<Recorder>(platform), every,
                               [&text](const PelorusModelNode& root, std::optional<RecordedTime> last) {
                                   text += fmt::format("{}@{} ", *root.value(),
                                                       last ? std::to_string(last->time_since_epoch().count())
                                                            : "never");
                               });
        char name = 'a';
        for (const auto time : times) {
            const std::byte content{static_cast<unsigned char>(name++)};
            monitor.receive({RecordedTime(time), {&content, 1}});
        }
        monitor.finish();
        historyLength = monitor.saveContents()->elements.size();
        return text;
    }

    ScriptedPlatform platform;
    std::size_t historyLength = 0;
};

TEST_F(OfflineMonitorTest, RefreshesOnceAtTheEndWithoutAnInterval)
{
    EXPECT_EQ(refreshes({}, {1s, 5s, 100s}), "abc@100000000000 ");
    EXPECT_EQ(historyLength, 1U);
}

TEST_F(OfflineMonitorTest, RefreshesWithoutAnyMessageOnlyWithoutAnInterval)
{
    EXPECT_EQ(refreshes({}, {}), "@never ");
    EXPECT_EQ(historyLength, 1U);
    EXPECT_EQ(refreshes(10ns, {}), "");
    EXPECT_EQ(historyLength, 0U);
}

TEST_F(OfflineMonitorTest, CountsTicksFromTheFirstMessage)
{
    EXPECT_EQ(refreshes(10ns, {7ns, 16ns, 18ns, 26ns, 29ns}), "ab@16 cd@26 e@29 ");
    EXPECT_EQ(historyLength, 3U);
}

TEST_F(OfflineMonitorTest, AMessageOnATickBelongsToTheTickBefore)
{
    EXPECT_EQ(refreshes(10ns, {0ns, 10ns, 11ns, 20ns, 21ns}), "ab@10 cd@20 e@21 ");
    EXPECT_EQ(refreshes(10ns, {0ns, 20ns, 21ns}), "a@0 b@20 c@21 ");
    EXPECT_EQ(refreshes(1ns, {0ns, 1ns, 2ns, 3ns}), "ab@1 c@2 d@3 ");
}

TEST_F(OfflineMonitorTest, PassesOverTicksInWhichNothingArrived)
{
    EXPECT_EQ(refreshes(10ns, {0ns, 95ns, 100ns, 101ns, 1000ns}), "a@0 bc@100 d@101 e@1000 ");
}

TEST_F(OfflineMonitorTest, TakesATimeThatGoesBackIntoTheTickInWork)
{
    EXPECT_EQ(refreshes(10ns, {100ns, 105ns, 20ns, 110ns, 111ns, 3ns}), "abcd@110 ef@3 ");
    EXPECT_EQ(refreshes(10ns, {-100ns, -91ns, -90ns, -89ns}), "abc@-90 d@-89 ");
}

TEST_F(OfflineMonitorTest, HasNoMoreThanTheLastRefreshWhenTheIntervalIsLong)
{
    EXPECT_EQ(refreshes(1'000'000'000s, {0s, 900'000'000s}), "ab@900000000000000000 ");
}

TEST_F(OfflineMonitorTest, SurvivesTheFarthestTimes)
{
    // The ends of what a recording can tell: further apart than 64 bits of nanoseconds, with a sign, reach.
    EXPECT_EQ(refreshes(2s, {-8'000'000'000s, 8'000'000'000s, 8'000'000'001s}),
              "a@-8000000000000000000 b@8000000000000000000 c@8000000001000000000 ");
    EXPECT_EQ(refreshes(1'000'000'000s, {8'000'000'000s, -8'000'000'000s, 8'000'000'000s}),
              "abc@8000000000000000000 ");
}

TEST_F(OfflineMonitorTest, KeepsFiveRefreshesInTheHistory)
{
    EXPECT_EQ(refreshes(1ns, {0ns, 2ns, 4ns, 6ns, 8ns, 10ns, 12ns}), "a@0 b@2 c@4 d@6 e@8 f@10 g@12 ");
    EXPECT_EQ(historyLength, 5U);
}

} // namespace pelorus
