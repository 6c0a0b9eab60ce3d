#include "LogGenerator/C2K/NumberText.h"

#include <cmath>
#include <cstdio>
#include <gtest/gtest.h>
#include <limits>
#include <random>

namespace pelorus::test {
namespace {

template <class Number> std::string written(const NumberText& format, Number number)
{
    std::string text = "something that was there before";
    format.write(text, number);
    return text;
}
std::string integer(const NumberText& format, std::int64_t number)
{
    return written(format, number);
}
std::string decimal(const NumberText& format, double number)
{
    return written(format, number);
}

TEST(NumberText, WritesIntegers)
{
    EXPECT_EQ(integer("%d", 0), "0");
    EXPECT_EQ(integer("%d", 9999), "9999");
    EXPECT_EQ(integer("%d", 10000), "10000");
    EXPECT_EQ(integer("a longer text before %d", 7), "a longer text before 7");
    EXPECT_EQ(integer("%d × 64chips", 65534), "65534 × 64chips");
    EXPECT_EQ(integer("%+d dBm", 0), "+0 dBm");
    EXPECT_EQ(integer("%+d dBm", -9999), "-9999 dBm");
    EXPECT_EQ(integer("0x%06x", 0x1F), "0x00001f");
    EXPECT_EQ(integer("0x%06x", 0xFFFFFFFF), "0xffffffff");
}

TEST(NumberText, PrintsTheLow32BitsAsSigned)
{
    EXPECT_EQ(integer("%d", 4294967295), "-1");
    EXPECT_EQ(integer("%d", 2147483648), "-2147483648");
    EXPECT_EQ(integer("%+d", 2147483647), "+2147483647");
}

TEST(NumberText, WritesTwoDecimals)
{
    EXPECT_EQ(decimal("%.2f kbps", 0), "0.00 kbps");
    EXPECT_EQ(decimal("%.2f kbps", 9999.99), "9999.99 kbps");
    EXPECT_EQ(decimal("%.2f kbps", 9999.996), "10000.00 kbps");
    EXPECT_EQ(decimal("%.2f kbps", -1e15), "-1000000000000000.00 kbps");
    EXPECT_EQ(decimal("%+.2f dB", -0.001), "-0.00 dB");
    EXPECT_EQ(decimal("%.02f%% (old)", 12.345678), "12.35% (old)");
    EXPECT_EQ(decimal("%+.2f", -std::numeric_limits<double>::infinity()), "-inf");
}

// printf decides ties by the exact value of the double.
TEST(NumberText, RoundsAsPrintf)
{
    EXPECT_EQ(decimal("%.2f", 0.125), "0.12");
    EXPECT_EQ(decimal("%.2f", 0.375), "0.38");
    EXPECT_EQ(decimal("%.2f", 1.005), "1.00"); // a little less than that
    std::mt19937_64 random(20120504);          // NOLINT(cert-msc51-cpp): repeatable on purpose
    for (int round = 0; round < 200'000; ++round) {
        // Tenths of hundredths, and numbers with all digits.
        const auto bits = static_cast<std::int64_t>(random() % 24'000'000) - 12'000'000;
        const double number = static_cast<double>(bits) / 1000.0 * (round % 2 == 0 ? 1.0 : 0.9871);
        char expected[64];
        std::snprintf(expected, sizeof expected, "%+.2f dB", number);
        ASSERT_EQ(decimal("%+.2f dB", number), expected);
    }
}

TEST(NumberText, WritesEveryEnergyAsPrintf)
{
    for (int energy = 1; energy <= 65535; ++energy) {
        const double number = 10 * std::log10(energy / 512.0);
        char expected[64];
        std::snprintf(expected, sizeof expected, "%+.2f dB", number);
        ASSERT_EQ(decimal("%+.2f dB", number), expected) << energy;
    }
}

} // namespace
} // namespace pelorus::test
