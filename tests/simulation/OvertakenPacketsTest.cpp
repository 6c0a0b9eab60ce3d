#include "LogGenerator/LogGenerator.h"
#include "platform/scripted/ScriptedPlatform.h"
#include "telephonyd/simulation/Simulation.h"
#include "tests/support/SectionFixture.h"

#include <gtest/gtest.h>
#include <random>

namespace pelorus::test {

/// Two generators that get the same messages: one is looked at after each of them, the other now and then.
class OvertakenPackets : public testing::TestWithParam<std::string_view> {
protected:
    struct Watched {
        explicit Watched(Platform& platform)
            : generator(LogGenerator::generatorFromTechnology(platform, GetParam()))
        {
            look();
        }
        std::string look()
        {
            state.remove("History"); // it is not what this is about, and copying it takes most of the time
            return textOf(generator->generateLogUsingState(state));
        }
        /// The name of the exception that ends the program, if one does.
        std::string receive(std::span<const std::byte> message)
        {
            try {
                generator->updateState(state, message);
                return "";
            } catch (const std::exception& exception) {
                return exception.what();
            }
        }

        std::unique_ptr<LogGenerator> generator;
        State state;
    };

    OvertakenPackets() { platform.useResourceDirectory(PELORUS_SOURCE_DIR "/resources"); }

    /// `spoil` may change a message first.
    template <class Spoil> void expectTheSameDisplays(std::size_t count, Spoil spoil)
    {
        Watched always(platform);
        Watched seldom(platform);
        const auto simulation = Simulation::create(GetParam(), 11, {});
        SimulatedMessage message;
        for (std::size_t number = 1; number <= count; ++number) {
            simulation->next(message);
            std::vector<std::byte> bytes(message.bytes.begin(), message.bytes.end());
            spoil(bytes);
            ASSERT_EQ(always.receive(bytes), seldom.receive(bytes)) << number;
            const std::string shown = always.look();
            if (number % 97 == 0) {
                ASSERT_EQ(seldom.look(), shown) << number;
            }
        }
    }

    static void leave(std::vector<std::byte>&) {}

    ScriptedPlatform platform;
};

TEST_P(OvertakenPackets, AreMissedByNobodyWhoLooksLater)
{
    expectTheSameDisplays(2'000, leave);
}

TEST_P(OvertakenPackets, AreMissedByNobodyWhileTheSystemLogListens)
{
    const RecordingLog log;
    expectTheSameDisplays(500, leave);
}

TEST_P(OvertakenPackets, AreMissedByNobodyWhenSomeAreBroken)
{
    std::mt19937 random(20120504); // NOLINT(cert-msc51-cpp): repeatable on purpose
    expectTheSameDisplays(2'000, [&random](std::vector<std::byte>& bytes) {
        if (random() % 4 == 0)
            bytes.resize(random() % (bytes.size() + 1));
        for (std::size_t place = 13 + random() % 40; place < bytes.size(); place += 1 + random() % 40)
            bytes[place] = static_cast<std::byte>(random());
    });
}

INSTANTIATE_TEST_SUITE_P(Generators, OvertakenPackets,
                         testing::Values("Osprey LTE", "Osprey GSM", "Osprey UTRAN2", "Osprey CDMA"));

} // namespace pelorus::test
