#include "telephonyd/simulation/Simulation.h"

#include <gtest/gtest.h>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;

constexpr HandsetTime kStart = std::chrono::sys_days(std::chrono::year(2024) / 5 / 1);

/// The first messages of a life one behind the other, without their time stamps.
std::string life(std::uint64_t seed, HandsetTime start = kStart, int messages = 5000)
{
    const auto simulation = Simulation::create("Osprey LTE", seed, start);
    std::string bytes;
    for (int i = 0; i < messages; ++i) {
        SimulatedMessage message;
        simulation->next(message);
        const auto* text = reinterpret_cast<const char*>(message.bytes.data());
        bytes.append(text, 5).append(text + 13, message.bytes.size() - 13);
    }
    return bytes;
}

} // namespace

TEST(Simulation, TellsTheSameStoryForTheSameSeed)
{
    EXPECT_TRUE(life(1) == life(1));
    EXPECT_TRUE(life(7) == life(7, kStart + 1234567us));
}

TEST(Simulation, TellsAnotherStoryForAnotherSeed)
{
    EXPECT_FALSE(life(1) == life(2));
    EXPECT_FALSE(life(0) == life(1));
}

TEST(Simulation, StampsMessagesWithTheTimeOfTheHandset)
{
    const auto simulation = Simulation::create("Osprey LTE", 1, kStart);
    SimulatedMessage message;
    std::chrono::nanoseconds last{};
    for (int i = 0; i < 1000; ++i) {
        simulation->next(message);
        std::uint64_t stamp = 0;
        for (std::size_t byte = 0; byte < 8; ++byte)
            stamp |= std::to_integer<std::uint64_t>(message.bytes[5 + byte]) << (8 * byte);
        EXPECT_EQ(stamp, logTime(kStart + message.time));
        EXPECT_GE(message.time, last);
        last = message.time;
    }
    EXPECT_GT(last, 60s);
    EXPECT_LT(last, 1h);
}

TEST(Simulation, KnowsNoOtherTechnologies)
{
    for (const char* known : {"IFX", "Osprey GSM", "Osprey CDMA", "Osprey LTE", "Osprey UTRAN2"})
        EXPECT_NE(Simulation::create(known, 1, kStart), nullptr) << known;
    EXPECT_EQ(Simulation::create("ifx", 1, kStart), nullptr);
    EXPECT_EQ(Simulation::create("Osprey lte", 1, kStart), nullptr);
    EXPECT_EQ(Simulation::create("", 1, kStart), nullptr);
}

} // namespace pelorus::test
