#include "platform/linux/LinuxPlatform.h"

#include "tests/linux/EventLoop.h"

#include <gtest/gtest.h>

namespace pelorus {

using namespace test;
using namespace std::chrono_literals;
using Clock = std::chrono::steady_clock;

TEST(MainQueue, RunsClosuresLaterAndInOrder)
{
    LinuxPlatform platform;
    std::string order;
    platform.dispatchAsyncOnMain([&] {
        order += 'a';
        platform.dispatchAsyncOnMain([&] { order += 'c'; });
    });
    platform.dispatchAsyncOnMain([&] { order += 'b'; });
    EXPECT_EQ(order, "");
    EXPECT_TRUE(spinUntil([&] { return order.size() == 3; }));
    EXPECT_EQ(order, "abc");
}

TEST(MainQueue, DelayedClosuresRunInTheOrderOfTheirTimeAndNeverEarly)
{
    LinuxPlatform platform;
    std::string order;
    const auto before = Clock::now();
    platform.dispatchAfterOnMain(60ms, [&] {
        EXPECT_GE(Clock::now() - before, 60ms);
        order += 'c';
    });
    platform.dispatchAfterOnMain(30'000'001ns, [&] {
        EXPECT_GE(Clock::now() - before, 30ms);
        order += 'b';
    });
    platform.dispatchAfterOnMain(0ns, [&] { order += 'a'; });
    platform.dispatchAfterOnMain(-5s, [&] { order += 'a'; });
    EXPECT_EQ(order, "");
    EXPECT_TRUE(spinUntil([&] { return order.size() == 4; }));
    EXPECT_EQ(order, "aabc");
}

TEST(MainQueue, WhatWaitsGoesWithThePlatform)
{
    auto platform = std::make_unique<LinuxPlatform>();
    int runs = 0;
    const auto held = std::make_shared<int>();
    platform->dispatchAsyncOnMain([&, held] { ++runs; });
    platform->dispatchAfterOnMain(1ms, [&, held] { ++runs; });
    const auto timer = platform->scheduleRepeatingTimer(0.001s, [&] { ++runs; });
    platform.reset();
    spinOnce();
    EXPECT_EQ(runs, 0);
    timer->invalidate();
    EXPECT_EQ(held.use_count(), 1);
}

TEST(MainQueue, ClosureMayDestroyThePlatform)
{
    auto platform = std::make_unique<LinuxPlatform>();
    platform->dispatchAsyncOnMain([&, text = std::string(100, 'x')] {
        platform.reset();
        EXPECT_EQ(text.size(), 100u);
    });
    EXPECT_TRUE(spinUntil([&] { return !platform; }));
}

TEST(MainQueue, TimerRepeatsUntilInvalidated)
{
    LinuxPlatform platform;
    int ticks = 0;
    const auto before = Clock::now();
    const auto timer = platform.scheduleRepeatingTimer(0.01s, [&] { ++ticks; });
    EXPECT_EQ(ticks, 0);
    EXPECT_TRUE(spinUntil([&] { return ticks == 5; }));
    EXPECT_GE(Clock::now() - before, 45ms);
    timer->invalidate();
    timer->invalidate();
    spinOnce();
    EXPECT_EQ(ticks, 5);
}

TEST(MainQueue, TimerGoesWithItsOwner)
{
    LinuxPlatform platform;
    int ticks = 0;
    platform.scheduleRepeatingTimer(0.001s, [&] { ++ticks; }).reset();
    spinOnce();
    EXPECT_EQ(ticks, 0);
}

TEST(MainQueue, TickMayDestroyItsTimerOrThePlatform)
{
    auto platform = std::make_unique<LinuxPlatform>();
    std::unique_ptr<RepeatingTimer> timer;
    int ticks = 0;
    timer = platform->scheduleRepeatingTimer(0.001s, [&, text = std::string(100, 'x')] {
        timer.reset();
        ticks += text.size() == 100;
    });
    EXPECT_TRUE(spinUntil([&] { return ticks > 0; }));
    spinOnce();
    EXPECT_EQ(ticks, 1);
    timer = platform->scheduleRepeatingTimer(0.001s, [&, text = std::string(100, 'x')] {
        platform.reset();
        ticks += text.size() == 100;
    });
    EXPECT_TRUE(spinUntil([&] { return ticks > 1; }));
    spinOnce();
    EXPECT_EQ(ticks, 2);
}

TEST(MainQueue, ExceptionEndsTheProgram)
{
    const auto run = [](auto schedule) {
        try {
            LinuxPlatform platform;
            schedule(platform, [] { throw std::runtime_error("from the closure"); });
            spinOnce();
        } catch (...) {
            ::_exit(0);
        }
    };
    const auto dies = testing::KilledBySignal(SIGABRT);
    EXPECT_EXIT(run([](auto& platform, auto closure) { platform.dispatchAsyncOnMain(closure); }), dies,
                "from the closure");
    EXPECT_EXIT(run([](auto& platform, auto closure) { platform.dispatchAfterOnMain(1ms, closure); }), dies,
                "from the closure");
    EXPECT_EXIT(run([](auto& platform, auto closure) {
                    static auto timer = platform.scheduleRepeatingTimer(0.001s, closure);
                }),
                dies, "from the closure");
}

} // namespace pelorus
