#include "tests/simulation/SimulatedLife.h"

#include <gmock/gmock.h>
#include <map>
#include <set>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;

struct Life {
    const char* technology;
    std::uint64_t seed;
};

void PrintTo(const Life& life, std::ostream* stream)
{
    *stream << life.technology << " of seed " << life.seed;
}

/// Without the time stamps.
std::string firstMinutes(const Life& life)
{
    std::string bytes;
    watch(life.technology, life.seed, 4min, [&bytes](const SeenMessage& message) {
        const auto* text = reinterpret_cast<const char*>(message.bytes().data());
        bytes.append(text, 5).append(text + 13, message.size() - 13);
    });
    return bytes;
}

std::set<std::uint32_t> codesOf(const std::string& technology)
{
    if (technology == "Osprey GSM")
        return {0x417A, 0x51F5, 0x7135, 0x51F6, 0x51FD, 0x51F4,   0x5137,   0x51FB,  0x5134, 0x5076,
                0x51F8, 0x51FF, 0x7130, 0x7132, 0x4005, 0x7131,   0x7150,   0x512C,  0x5072, 0x4125,
                0x4031, 0x4127, 0x4157, 0x4116, 0x4221, 0xFF0000, 0xFF0001, 0xFF0002};
    if (technology == "Osprey CDMA")
        return {0x108A, 0x1183, 0x1192, 0x12B6, 0x119C, 0x119D, 0x127E, 0x134F};
    return {0xD0E0, 0xD0E2, 0xD00A, 0xD00E, 0xD00C, 0xFF0000, 0xFF0001, 0xFF0002};
}

class SimulatedLife : public testing::TestWithParam<Life> {};

} // namespace

TEST_P(SimulatedLife, IsTheSameForTheSameSeed)
{
    const std::string bytes = firstMinutes(GetParam());
    EXPECT_GT(bytes.size(), 50000U);
    EXPECT_TRUE(bytes == firstMinutes(GetParam()));
    EXPECT_FALSE(bytes == firstMinutes({GetParam().technology, GetParam().seed + 1}));
}

TEST_P(SimulatedLife, SendsEveryCodeWithinTenMinutes)
{
    std::set<std::uint32_t> codes;
    watch(GetParam().technology, GetParam().seed, 10min,
          [&codes](const SeenMessage& message) { codes.insert(message.code()); });
    EXPECT_EQ(codes, codesOf(GetParam().technology));
}

TEST_P(SimulatedLife, FramesItsMessages)
{
    double last = 0;
    int faults = 0;
    watch(GetParam().technology, GetParam().seed, 1h, [&](const SeenMessage& message) {
        const bool isInternal = message.code() > 0xFFFF;
        faults += message.u8(0) != (isInternal ? 0xFF : 1);
        faults += static_cast<std::size_t>(message.u16(1)) != message.size() - 1;
        faults += static_cast<unsigned>(message.u16(3)) != (message.code() & 0xFFFF);
        faults += message.seconds() < last;
        last = message.seconds();
    });
    EXPECT_EQ(faults, 0);
    EXPECT_GT(last, 3590);
}

TEST_P(SimulatedLife, LogsAsOftenAsAModem)
{
    std::map<std::uint32_t, int> counts;
    int all = 0;
    watch(GetParam().technology, GetParam().seed, 1h, [&](const SeenMessage& message) {
        ++counts[message.code()];
        ++all;
    });
    EXPECT_GT(all, 10 * 3600);
    EXPECT_LT(all, 40 * 3600);
    if (!codesOf(GetParam().technology).contains(0xFF0001))
        return;
    const int lists = counts[0xFF0000] + counts[0xFF0001] + counts[0xFF0002];
    EXPECT_LT(lists * 100, all) << "property lists among the packets";
    EXPECT_GE(counts[0xFF0001], 115) << "at least every half minute";
    EXPECT_EQ(counts[0xFF0000], 2) << "at the start, and half an hour later";
}

INSTANTIATE_TEST_SUITE_P(Seeds, SimulatedLife,
                         testing::Values(Life{"Osprey GSM", 1}, Life{"Osprey GSM", 2}, Life{"Osprey GSM", 3},
                                         Life{"Osprey GSM", 4}, Life{"Osprey GSM", 77},
                                         Life{"Osprey GSM", 123456789}, Life{"Osprey UTRAN2", 1},
                                         Life{"Osprey UTRAN2", 2}, Life{"Osprey UTRAN2", 77},
                                         Life{"Osprey UTRAN2", 123456789}, Life{"Osprey CDMA", 1},
                                         Life{"Osprey CDMA", 2}, Life{"Osprey CDMA", 77},
                                         Life{"Osprey CDMA", 123456789}));

} // namespace pelorus::test
