#include "tests/simulation/SimulatedLife.h"
#include "tests/simulation/StateHistory.h"

#include <algorithm>
#include <cmath>
#include <fmt/format.h>
#include <gmock/gmock.h>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;

/// Counters of packets, and the bits that they stand for.
struct Counters {
    std::int64_t sequence = -1;
    std::vector<std::int64_t> counts;
    std::int64_t bits = 0;
};

/// An hour of the EV-DO half of a handset's life, every message looked at.
class EvdoHandsetLife : public testing::TestWithParam<std::uint64_t> {
protected:
    EvdoHandsetLife()
    {
        watch("Osprey CDMA", GetParam(), 1h, [this](const SeenMessage& message) { see(message); });
    }

    void see(const SeenMessage& message)
    {
        now = message.seconds();
        switch (message.code()) {
        case 0x1183:
            return seeSummary(message);
        case 0x12B6:
            return seePilots(message);
        case 0x108A:
            return seeFingers(message);
        case 0x1192:
            return seeForward(message);
        case 0x127E:
            return seeReverse(message);
        default:
            return;
        }
    }

    void seeSummary(const SeenMessage& message)
    {
        expect(message.size() == 50, "length of 1183");
        expect((message.u16(13) & 0x7FF) == 425 && message.u8(14) >> 3 == 1, "1.9 GHz, channel 425");
        state = message.u8(36);
        states.enter(state);
        sessions.enter(message.u8(37));
        const int level = message.s8(15);
        expect(level >= -105 && level <= -25 && std::abs(level - message.s8(16)) <= 10, "levels");
        if (state == 5)
            expect(std::abs(level + message.s8(17) + 75) < 16, "the more loss, the more power");
        serving = message.u16(18);
        expect((serving == 0xFFFF) == (state < 2), "serving pilot");
        const int color = message.u8(41);
        if (message.u8(37) > 0)
            terminals[color].insert(message.u32(38) & 0xFFFFFF);
    }

    void seePilots(const SeenMessage& message)
    {
        const int count = message.u8(15);
        expect(message.size() == static_cast<std::size_t>(25 + 12 * count), "length of 12B6");
        expect(state < 2 ? count == 0 : state < 5 ? count == 1 : count >= 1, "number of pilots");
        pilots.clear();
        double together = 0;
        for (int pilot = 0; pilot < count; ++pilot) {
            const auto record = static_cast<std::size_t>(25 + 12 * pilot);
            expect(message.u16(record + 2) >= 1, "energy");
            together += message.u16(record + 2) / 512.0;
            expect(pilots.insert(message.u16(record)).second, "the same pilot twice");
        }
        expect(together < 1.01, "all pilots are part of what is received");
        mostPilots = std::max(mostPilots, count);
        if (state == 5 && pilots != lastPilots && !lastPilots.empty())
            ++changes;
        lastPilots = pilots;
    }

    void seeFingers(const SeenMessage& message)
    {
        expect(message.u8(22) == 6 && message.size() == 23 + 14 * 6, "length of 108A");
        for (std::size_t finger = 23; finger < message.size(); finger += 14) {
            if (message.u16(finger) == 0xFFFF)
                continue;
            expect(pilots.contains(message.u16(finger)), "finger of a pilot in the active set");
            const double ratio = 10 * std::log10(message.u16(finger + 6) / 512.0);
            expect(ratio > -17 && ratio < 15, "C/I");
        }
    }

    /// Data flows in kbit/s.
    double rate(const Counters& before, const Counters& after)
    {
        for (std::size_t index = 0; index < after.counts.size() && !before.counts.empty(); ++index)
            expect(after.counts[index] >= before.counts[index], "a counter that goes back");
        if (before.sequence < 0)
            return 0;
        const std::int64_t seconds = after.sequence - before.sequence;
        expect(seconds >= 1, "sequence number");
        return static_cast<double>(after.bits - before.bits) / (static_cast<double>(seconds) * 1024.0);
    }

    void seeForward(const SeenMessage& message)
    {
        expect(message.size() == 241, "length of 1192");
        // Bits of a packet, by counter; what carries none does not count.
        static const std::map<std::size_t, int> kBits = {
            {5, 128},   {10, 128},  {15, 128},  {20, 128},  {34, 512},  {38, 1024},
            {45, 4096}, {8, 1024},  {13, 1024}, {18, 1024}, {23, 1024}, {36, 2048},
            {39, 3072}, {47, 1024}, {48, 3072}, {50, 4096}, {52, 5120}, {54, 5120}};
        Counters counters{message.u32(13), {}, 0};
        for (std::size_t index = 0; index < 56; ++index) {
            counters.counts.push_back(message.u32(17 + 4 * index));
            if (const auto bits = kBits.find(index); bits != kBits.end())
                counters.bits += bits->second * counters.counts.back();
        }
        note(forwardRates, rate(forward, counters));
        forward = counters;
    }

    void seeReverse(const SeenMessage& message)
    {
        expect(message.size() == 1750, "length of 127E");
        static constexpr int kBits[] = {128, 256, 512, 768, 1024, 1536, 2048, 3072, 4096, 6144, 8192, 12288};
        Counters counters{message.u32(14), {}, 0};
        for (std::size_t payload = 0; payload < 12; ++payload)
            for (std::size_t subpacket = 0; subpacket < 4; ++subpacket) {
                counters.counts.push_back(message.u32(18 + 24 * payload + 4 * subpacket));
                counters.bits += kBits[payload] * counters.counts.back();
            }
        note(reverseRates, rate(reverse, counters));
        reverse = counters;
        wasConnected = state == 5;
    }

    void note(std::vector<double>& rates, double rate)
    {
        if (state == 5 && wasConnected)
            rates.push_back(rate);
        else if (state != 5 && !wasConnected)
            expect(rate == 0, "data without a connection");
    }

    void expect(bool holds, const std::string& fault)
    {
        if (!holds && faults.size() < 20)
            faults.push_back(fmt::format("at {:.2f} s: {}", now, fault));
    }

    double now = 0;
    int state = -1;
    int serving = -1;
    StateHistory states;
    StateHistory sessions;
    std::vector<std::string> faults;
    std::map<int, std::set<std::int64_t>> terminals; // by colour code
    std::set<int> pilots;
    std::set<int> lastPilots;
    int mostPilots = 0;
    int changes = 0;
    Counters forward;
    Counters reverse;
    bool wasConnected = false;
    std::vector<double> forwardRates;
    std::vector<double> reverseRates;
};

} // namespace

TEST_P(EvdoHandsetLife, ShowsMeasurementsThatHangTogether)
{
    EXPECT_EQ(faults, std::vector<std::string>());
    EXPECT_GE(mostPilots, 2);
    EXPECT_GE(changes, 20) << "pilots change while it is connected";
}

TEST_P(EvdoHandsetLife, ChangesItsStatesInOrder)
{
    states.expectOnly(0, {{0, {1}}, {1, {2}}, {2, {3}}, {3, {0, 3, 4}}, {4, {5}}, {5, {3, 5}}});
    for (const auto& [from, to] : {std::pair(0, 1), {2, 3}, {3, 4}, {4, 5}, {5, 3}, {3, 0}})
        EXPECT_TRUE(states.has(from, to)) << from << " to " << to;
}

TEST_P(EvdoHandsetLife, OpensOneSession)
{
    sessions.expectOnly(0, {{0, {0, 1}}, {1, {1, 2}}, {2, {2, 3}}, {3, {3, 4}}, {4, {4}}});
    EXPECT_TRUE(sessions.has(3, 4));
}

TEST_P(EvdoHandsetLife, HasAnotherAddressInEachSubnet)
{
    ASSERT_EQ(terminals.size(), 2U);
    for (const std::int64_t address : terminals[42])
        EXPECT_FALSE(terminals[77].contains(address));
}

TEST_P(EvdoHandsetLife, LoadsPagesAndWaits)
{
    ASSERT_GT(forwardRates.size(), 300U);
    const auto [least, most] = std::minmax_element(forwardRates.begin(), forwardRates.end());
    EXPECT_LT(*least, 10) << "somebody reads";
    EXPECT_GT(*most, 500);
    EXPECT_LT(*most, 3072 * 0.9) << "the sector has other users";
    const auto [slowest, fastest] = std::minmax_element(reverseRates.begin(), reverseRates.end());
    EXPECT_LT(*slowest, 5);
    EXPECT_GT(*fastest, 100);
    EXPECT_LT(*fastest, 600);
}

INSTANTIATE_TEST_SUITE_P(Seeds, EvdoHandsetLife, testing::Values(1, 2, 3, 123456789));

} // namespace pelorus::test
