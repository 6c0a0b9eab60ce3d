#include "telephonyd/server/Pace.h"

#include <gtest/gtest.h>
#include <limits>

namespace pelorus::test {

using namespace std::chrono_literals;

namespace {

/// When messages at these times go out.
std::vector<Pace::Time> schedule(Pace pace, std::initializer_list<Pace::Time> times)
{
    std::vector<Pace::Time> due;
    for (const Pace::Time time : times) {
        pace.advance(time);
        due.push_back(pace.due());
        pace.sent();
    }
    return due;
}

using Times = std::vector<Pace::Time>;

} // namespace

TEST(Pace, KeepsTheGapsOfTheSource)
{
    EXPECT_EQ(schedule(Pace::ownTiming(1), {1000s, 1001s, 1001s, 1003500ms}), (Times{0s, 1s, 1s, 3500ms}));
}

TEST(Pace, ScalesTheGapsBySpeed)
{
    EXPECT_EQ(schedule(Pace::ownTiming(4), {0s, 2s, 10s}), (Times{0s, 500ms, 2500ms}));
    EXPECT_EQ(schedule(Pace::ownTiming(0.5), {0s, 2s, 10s}), (Times{0s, 4s, 20s}));
}

TEST(Pace, LeavesNoGapWhereTheClockGoesBack)
{
    EXPECT_EQ(schedule(Pace::ownTiming(1), {10s, 12s, 5s, 6s}), (Times{0s, 2s, 2s, 3s}));
}

TEST(Pace, HasNoGapsAtSpeed0)
{
    EXPECT_EQ(schedule(Pace::ownTiming(0), {10s, 12s, 500s}), (Times{0s, 0s, 0s}));
}

TEST(Pace, SurvivesTimesThatMakeNoSense)
{
    constexpr Pace::Time kFirst = Pace::Time::min();
    constexpr Pace::Time kLast = Pace::Time::max();
    for (const double speed : {1e-300, 1.0, 1e300}) {
        const Times due =
            schedule(Pace::ownTiming(speed), {kFirst, kLast, kFirst, 0s, kLast, 0s, kLast, 1s, kLast});
        EXPECT_TRUE(std::is_sorted(due.begin(), due.end()));
        EXPECT_EQ(due[0], 0s);
    }
}

TEST(Pace, CountsOnlySentMessagesAtARate)
{
    Pace pace = Pace::rate(4);
    pace.advance(0s);
    EXPECT_EQ(pace.due(), 0s);
    pace.sent();
    pace.advance(100s); // passed over
    pace.advance(200s);
    EXPECT_EQ(pace.due(), 250ms);
    pace.sent();
    EXPECT_EQ(pace.due(), 500ms);
}

TEST(Pace, GoesOnAtOnceWhenTheSourceStartsOver)
{
    Pace pace = Pace::ownTiming(1);
    pace.advance(100s);
    pace.advance(103s);
    pace.startOver();
    pace.advance(100s);
    EXPECT_EQ(pace.due(), 3s);
    pace.advance(101s);
    EXPECT_EQ(pace.due(), 4s);
}

TEST(Pace, RestsAfterARoundThatTookNoTime)
{
    Pace pace = Pace::ownTiming(1);
    pace.advance(100s);
    pace.advance(100s);
    pace.startOver();
    pace.advance(100s);
    EXPECT_EQ(pace.due(), 1s);
    pace.startOver();
    pace.advance(100s);
    EXPECT_EQ(pace.due(), 2s);

    Pace fast = Pace::ownTiming(0);
    fast.advance(100s);
    fast.startOver();
    fast.advance(100s);
    EXPECT_EQ(fast.due(), 0s);
}

} // namespace pelorus::test
