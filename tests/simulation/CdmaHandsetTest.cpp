#include "tests/simulation/SimulatedLife.h"
#include "tests/simulation/StateHistory.h"

#include <algorithm>
#include <cmath>
#include <fmt/format.h>
#include <gmock/gmock.h>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;

double decibels(double ratio)
{
    return 10.0 * std::log10(ratio);
}

/// An hour of the 1x half of a handset's life, every message looked at.
class CdmaHandsetLife : public testing::TestWithParam<std::uint64_t> {
protected:
    CdmaHandsetLife()
    {
        watch("Osprey CDMA", GetParam(), 1h, [this](const SeenMessage& message) { see(message); });
    }

    void see(const SeenMessage& message)
    {
        now = message.seconds();
        switch (message.code()) {
        case 0x119C:
            return seeState(message);
        case 0x119D:
            return seeFrame(message);
        case 0x134F:
            return seeSystem(message);
        default:
            return;
        }
    }

    /// Where the subpackets begin, by identifier; they fill the packet.
    std::map<int, std::size_t> subpacketsOf(const SeenMessage& message)
    {
        std::map<int, std::size_t> starts;
        std::size_t start = 17;
        for (int index = 0; index < message.u8(14) && start + 4 <= message.size(); ++index) {
            starts[message.u8(start)] = start;
            start += static_cast<std::size_t>(message.u16(start + 2));
        }
        expect(start == message.size(), "subpackets fill the packet");
        return starts;
    }

    void seeState(const SeenMessage& message)
    {
        const auto starts = subpacketsOf(message);
        ASSERT_EQ(starts.size(), 4U);
        state = message.u8(starts.at(1) + 4);
        states.enter(state);
        const std::size_t radio = starts.at(2);
        expect(message.u8(radio + 4) == 0 && message.u16(radio + 6) == 384, "800 MHz, channel 384");
        const double level = message.s8(radio + 10) * 0.334 - 63.248;
        expect(level >= -105.5 && level <= -24.5, "level");
        if (state == 8) {
            const double sent = message.s16(radio + 12) / 10.0;
            expect(sent >= -50 && sent <= 23.5, "power");
            expect(std::abs(level + sent + 76) < 16, "the more loss, the more power");
            const double other = message.s8(radio + 11) * 0.334 - 63.248;
            expect(std::abs(level - other) < 10, "receive chains");
        }
        seeActiveSet(message, starts.at(3));
    }

    void seeActiveSet(const SeenMessage& message, std::size_t start)
    {
        const int count = message.u8(start + 8);
        const int chains = message.u8(start + 9);
        const auto stride = static_cast<std::size_t>((6 * chains + 15) & 0xFFC);
        const double a = message.u16(start + 4);
        const double scale =
            std::pow(2.0, 2 * message.u8(start + 7) - 3) / (9 * a * a * message.u8(start + 6));
        double together = 0;
        pilots.clear();
        for (int index = 0; index < count; ++index) {
            const std::size_t record = start + 12 + static_cast<std::size_t>(index) * stride;
            const int energy = message.u16(record + 12 + 4 * static_cast<std::size_t>(chains));
            const double strength = scale * energy - 1 / a;
            expect(strength > 0.0038 && strength < 1, fmt::format("Ec/Io of {:.4f}", strength));
            together += strength;
            pilots.push_back(message.u16(record));
            pilotsSeen.insert(message.u16(record));
        }
        expect(together < 1, "all pilots are part of what is received");
        expect(state == 8 ? count >= 1 && count <= 4
                          : count == (state == 11 || state == 2 || state == 3 ? 0 : 1),
               fmt::format("{} pilots in state {}", count, state));
        if (count > 0)
            expect(std::find(pilots.begin(), pilots.end(), message.u16(start + 10)) != pilots.end(),
                   "reference pilot");
        mostPilots = std::max(mostPilots, count);
        if (count > 0)
            bestStrength = decibels(together);
    }

    void seeFrame(const SeenMessage& message)
    {
        expect(state == 8, "traffic frames outside of traffic");
        const auto starts = subpacketsOf(message);
        ASSERT_TRUE(starts.contains(11));
        const bool isLost = message.u8(starts.at(11) + 24) != 0;
        (bestStrength > -5 ? strong : weak).first += isLost ? 1 : 0;
        ++(bestStrength > -5 ? strong : weak).second;
        if (lastFrame > 0 && now - lastFrame < 1)
            expect(std::abs(now - lastFrame - 0.02) < 0.005, "20 ms a frame");
        lastFrame = now;
    }

    void seeSystem(const SeenMessage& message)
    {
        expect(message.size() >= 186 && message.u8(13) == 2 && message.u32(46) == 2, "134F");
        const int base = message.u16(184);
        const bool isPartner = message.u16(50) == 4190;
        expect(message.u16(50) == (base > 10000 ? 4190 : 4182), "SID of the base station");
        expect(message.u32(42) == (isPartner ? 1 : 0), "the roaming light is on in the partner's system");
        expect(message.u8(133) == 6, "protocol revision");
        bases.insert(base);
        systems.insert(message.u16(50));
    }

    void expect(bool holds, const std::string& fault)
    {
        if (!holds && faults.size() < 20)
            faults.push_back(fmt::format("at {:.2f} s: {}", now, fault));
    }

    double now = 0;
    double lastFrame = 0;
    int state = -1;
    StateHistory states;
    std::vector<std::string> faults;
    std::vector<int> pilots;
    std::set<int> pilotsSeen;
    std::set<int> bases;
    std::set<int> systems;
    int mostPilots = 0;
    double bestStrength = 0;
    std::pair<int, int> strong; // frames lost, and all
    std::pair<int, int> weak;
};

} // namespace

TEST_P(CdmaHandsetLife, ShowsMeasurementsThatHangTogether)
{
    EXPECT_EQ(faults, std::vector<std::string>());
    EXPECT_GE(mostPilots, 2) << "soft handoff";
    EXPECT_GE(pilotsSeen.size(), 5U);
}

TEST_P(CdmaHandsetLife, ChangesItsStatesInOrder)
{
    states.expectOnly(
        11,
        {{11, {2}}, {2, {3}}, {3, {4}}, {4, {5}}, {5, {6}}, {6, {6, 7, 8}}, {7, {9}}, {8, {2, 8}}, {9, {6}}});
    for (const auto& [from, to] : {std::pair(11, 2), {6, 7}, {7, 9}, {9, 6}, {6, 8}, {8, 8}, {8, 2}})
        EXPECT_TRUE(states.has(from, to)) << from << " to " << to;
}

TEST_P(CdmaHandsetLife, LosesAFrameInAHundredAndMoreWhereReceptionIsWeak)
{
    const double lost = strong.first + weak.first;
    const double all = strong.second + weak.second;
    EXPECT_GT(all, 20'000);
    EXPECT_GT(lost / all, 0.004);
    EXPECT_LT(lost / all, 0.02);
    EXPECT_GT(1.0 * weak.first / weak.second, 1.2 * strong.first / strong.second);
}

TEST_P(CdmaHandsetLife, ComesThroughTwoSystems)
{
    EXPECT_GE(bases.size(), 5U);
    EXPECT_EQ(systems, (std::set<int>{4182, 4190}));
}

INSTANTIATE_TEST_SUITE_P(Seeds, CdmaHandsetLife, testing::Values(1, 2, 3, 123456789));

} // namespace pelorus::test
