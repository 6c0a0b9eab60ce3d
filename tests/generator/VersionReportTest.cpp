#include "LogGenerator/Osprey/VersionReport.h"

#include <algorithm>
#include <array>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace pelorus::test {
namespace {

constexpr std::uint64_t kTime = 0x0001'FF2E'4FA3'A198; // 2012-05-04 09:30:00, -210 minutes, summer time

struct Report {
    std::vector<std::byte> bytes = std::vector<std::byte>(200, std::byte{0xEE});
    std::uint32_t written = 99;
    std::uint32_t result = 99;

    unsigned at(std::size_t place) const { return std::to_integer<unsigned>(bytes.at(place)); }
    unsigned u16(std::size_t place) const { return at(place) | at(place + 1) << 8; }
    /// The bytes of a text field up to its NUL.
    std::string text(std::size_t place, std::size_t width) const
    {
        std::string content;
        for (std::size_t index = place; index < place + width && at(index) != 0; ++index)
            content += static_cast<char>(at(index));
        return content;
    }
    bool isFilledWith(std::size_t begin, std::size_t end, unsigned value) const
    {
        return std::all_of(bytes.begin() + static_cast<std::ptrdiff_t>(begin),
                           bytes.begin() + static_cast<std::ptrdiff_t>(end),
                           [value](std::byte byte) { return byte == std::byte(value); });
    }
};

Report report(std::uint32_t capacity, std::string_view version = "(none)",
              std::string_view executable = "EXECUTABLE_NAME",
              std::string_view buildDate = "May  4 2012 09:30:00", std::uint64_t time = kTime)
{
    Report made;
    made.result = KilnDLFAddVersionReport(made.bytes, capacity, made.written, 0x0102, 0x0304, version,
                                          executable, buildDate, time);
    return made;
}

TEST(VersionReport, HasEveryFieldInItsPlace)
{
    const Report made = report(161);
    EXPECT_EQ(made.result, 0U);
    EXPECT_EQ(made.written, 161U);
    EXPECT_EQ(made.u16(0), 0x00A1U);
    EXPECT_EQ(made.u16(2), 0x1FFDU);
    EXPECT_TRUE(made.isFilledWith(4, 12, 0));
    EXPECT_EQ(made.u16(12), 0x0102U);
    EXPECT_EQ(made.u16(14), 0x0304U);
    EXPECT_EQ(made.text(16, 7), "(none)");
    EXPECT_EQ(made.at(22), 0U);
    EXPECT_EQ(made.text(23, 16), "EXECUTABLE_NAME");
    EXPECT_EQ(made.at(38), 0U);
    EXPECT_TRUE(made.isFilledWith(39, 63, 0));
    EXPECT_EQ(made.text(63, 18), "May  4 2012 09:30");
    EXPECT_EQ(made.at(80), 0U);
    EXPECT_EQ(made.u16(81), 0xA198U);
    EXPECT_EQ(made.u16(83), 0x4FA3U);
    EXPECT_EQ(made.u16(85), 0xFF2EU);
    EXPECT_EQ(made.u16(87), 1U);
    EXPECT_TRUE(made.isFilledWith(89, 161, 0));
    EXPECT_TRUE(made.isFilledWith(161, 200, 0xEE));
}

TEST(VersionReport, CutsTextsToTheirFieldLessOne)
{
    const Report made = report(161, "Pelorus 1.0.0", "0123456789ABCDEFGH", "0123456789ABCDEFGH");
    EXPECT_EQ(made.text(16, 7), "Peloru");
    EXPECT_EQ(made.at(22), 0U);
    EXPECT_EQ(made.text(23, 16), "0123456789ABCDE");
    EXPECT_EQ(made.at(38), 0U);
    EXPECT_EQ(made.text(63, 18), "0123456789ABCDEFG");
    EXPECT_EQ(made.at(80), 0U);
}

TEST(VersionReport, PadsShortTexts)
{
    const Report made = report(161, "", "x", "");
    EXPECT_TRUE(made.isFilledWith(16, 23, 0));
    EXPECT_EQ(made.text(23, 16), "x");
    EXPECT_TRUE(made.isFilledWith(24, 81, 0));
}

TEST(VersionReport, NeedsItsWholeLength)
{
    for (const std::uint32_t capacity : {0U, 1U, 160U}) {
        const Report made = report(capacity);
        EXPECT_EQ(made.result, 3U);
        EXPECT_EQ(made.written, 0U);
        EXPECT_TRUE(made.isFilledWith(0, 200, 0xEE));
    }
}

TEST(VersionReport, TakesMoreRoomThanItNeeds)
{
    const Report made = report(200);
    EXPECT_EQ(made.result, 0U);
    EXPECT_EQ(made.written, 161U);
    EXPECT_TRUE(made.isFilledWith(161, 200, 0xEE));
}

TEST(VersionReport, NeverWritesBeyondTheBufferItself)
{
    std::vector<std::byte> buffer(160, std::byte{0xEE});
    std::uint32_t written = 99;
    EXPECT_EQ(KilnDLFAddVersionReport(buffer, 161, written, 1, 1, "", "", "", 0), 3U);
    EXPECT_EQ(written, 0U);
}

TEST(VersionReport, IgnoresTheTopByteOfTheTime)
{
    const Report made = report(161, "", "", "", 0xAB00'0000'0000'0000);
    EXPECT_TRUE(made.isFilledWith(81, 89, 0));
}

} // namespace
} // namespace pelorus::test
