#include "LogGenerator/Osprey/Format.h"

#include "LogGenerator/Osprey/Row.h"
#include "tests/support/PacketBuilder.h"

#include <cstdio>
#include <gtest/gtest.h>

namespace pelorus::test {
namespace {

std::string integerText(const Format& format, std::int64_t value)
{
    std::string out = "what was there";
    format.write(out, value);
    return out;
}

std::string fixedText(const Format& format, std::int64_t hundredMillionths)
{
    std::string out = "what was there";
    format.writeFixed(out, hundredMillionths);
    return out;
}

std::string rowText(const Row& row, unsigned raw)
{
    Value value;
    EXPECT_TRUE(writeRow(row, PacketView(PacketBuilder(2).u16(0, raw).bytes()), value));
    return *value.string();
}

TEST(Format, PrintsIntegersOfThirtyTwoBits)
{
    EXPECT_EQ(integerText("%d", 0), "0");
    EXPECT_EQ(integerText("%d", 2147483647), "2147483647");
    EXPECT_EQ(integerText("%d", 4294967295), "-1");
    EXPECT_EQ(integerText("%d", 2147483648), "-2147483648");
    EXPECT_EQ(integerText("%d", -140), "-140");
    EXPECT_EQ(integerText("%u", 4294967295), "4294967295");
    EXPECT_EQ(integerText("%u", -1), "4294967295");
    EXPECT_EQ(integerText("%u", 0), "0");
}

TEST(Format, KeepsTheTextAroundTheConversion)
{
    EXPECT_EQ(integerText("%d dBm", -30), "-30 dBm");
    EXPECT_EQ(integerText("[Bad Value %d]", 12), "[Bad Value 12]");
    EXPECT_EQ(integerText("a%ub", 7), "a7b");
}

TEST(Format, RoundsHalvesToTheEvenDigit)
{
    EXPECT_EQ(fixedText("%4.2f dB", -1'062'500'000), "-10.62 dB");
    EXPECT_EQ(fixedText("%4.2f dB", -1'087'500'000), "-10.88 dB");
    EXPECT_EQ(fixedText("%4.2f dB", 12'500'000), "0.12 dB");
    EXPECT_EQ(fixedText("%4.2f dB", 12'500'001), "0.13 dB");
    EXPECT_EQ(fixedText("%f", 50'000'000), "0.500000");
    EXPECT_EQ(fixedText("%f", 390'625), "0.003906"); // 0.00390625, below the half
}

TEST(Format, ShowsTheWidestNumberThatItTakes)
{
    EXPECT_EQ(fixedText("%f", INT64_MAX), "92233720368.547758");
    EXPECT_EQ(fixedText("%4.2f", INT64_MIN), "-92233720368.55");
}

struct Scale {
    unsigned width; // of the field
    Row row;
    const char* format;
    double factor, addend;
};

class FormatOfLevel : public testing::TestWithParam<Scale> {};

TEST_P(FormatOfLevel, IsWhatPrintfGivesForEveryRawValue)
{
    const auto& [width, row, format, factor, addend] = GetParam();
    for (unsigned raw = 0; raw < 1U << width; ++raw) {
        char expected[64];
        std::snprintf(expected, sizeof expected, format, raw * factor + addend);
        ASSERT_EQ(rowText(row, raw), expected) << raw;
    }
}

INSTANTIATE_TEST_SUITE_P(
    Scales, FormatOfLevel,
    testing::Values(Scale{9, level("", "%4.2f dBm", bits(0, 0, 9), 0.25, -140.0), "%4.2f dBm", 0.25, -140.0},
                    Scale{9, level("", "%4.2f dBm", bits(0, 0, 9), 0.5, -140.0), "%4.2f dBm", 0.5, -140.0},
                    Scale{7, level("", "%4.2f dB", bits(0, 0, 7), 0.25, -30.0), "%4.2f dB", 0.25, -30.0},
                    Scale{7, level("", "%4.2f dB", bits(0, 0, 7), 0.125, -20.0), "%4.2f dB", 0.125, -20.0},
                    Scale{16, level("", "%4.2f dBm", u16(0), 0.25, -140.0), "%4.2f dBm", 0.25, -140.0},
                    Scale{16, level("", "%4.2f dBm", u16(0), 0.5, -140.0), "%4.2f dBm", 0.5, -140.0},
                    Scale{16, level("", "%4.2f dB", u16(0), 0.125, -20.0), "%4.2f dB", 0.125, -20.0},
                    Scale{16, level("", "%f", u16(0), 0.00390625, 0.0), "%f", 0.00390625, 0.0}),
    [](const testing::TestParamInfo<Scale>& scale) { return std::to_string(scale.index); });

} // namespace
} // namespace pelorus::test
