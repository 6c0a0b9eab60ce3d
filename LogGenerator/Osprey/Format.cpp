#include "LogGenerator/Osprey/Format.h"

#include <algorithm>
#include <array>
#include <fmt/format.h>

namespace pelorus {

namespace {

constexpr std::size_t kLongestRow = 64;

} // namespace

void Format::finish(std::string& out, const char* digits, std::size_t count) const
{
    std::array<char, kLongestRow> row; // NOLINT(cppcoreguidelines-pro-type-member-init): filled below
    char* end = std::copy(prefix.begin(), prefix.end(), row.data());
    end = std::copy_n(digits, count, end);
    end = std::copy(suffix.begin(), suffix.end(), end);
    out.assign(row.data(), end);
}

void Format::write(std::string& out, std::int64_t value) const
{
    const auto low = static_cast<std::uint32_t>(value);
    const fmt::format_int digits =
        isUnsigned ? fmt::format_int(low) : fmt::format_int(static_cast<std::int32_t>(low));
    finish(out, digits.data(), digits.size());
}

void Format::writeFixed(std::string& out, std::int64_t value) const
{
    const unsigned places = hasSixDecimals ? 6 : 2;
    const std::uint64_t unit = hasSixDecimals ? 1'000'000 : 100;
    const std::uint64_t divisor = static_cast<std::uint64_t>(kOne) / unit;
    const std::uint64_t magnitude =
        value < 0 ? 0 - static_cast<std::uint64_t>(value) : static_cast<std::uint64_t>(value);
    std::uint64_t rounded = magnitude / divisor;
    const std::uint64_t twiceTheRest = magnitude % divisor * 2;
    if (twiceTheRest > divisor || (twiceTheRest == divisor && rounded % 2 == 1))
        ++rounded;

    std::array<char, 40> digits; // NOLINT(cppcoreguidelines-pro-type-member-init): filled from the end below
    char* begin = digits.end();
    std::uint64_t fraction = rounded % unit;
    for (unsigned place = 0; place < places; ++place, fraction /= 10)
        *--begin = static_cast<char>('0' + fraction % 10);
    *--begin = '.';
    const fmt::format_int whole(rounded / unit);
    begin = std::copy_backward(whole.data(), whole.data() + whole.size(), begin);
    if (value < 0)
        *--begin = '-';
    finish(out, begin, static_cast<std::size_t>(digits.end() - begin));
}

} // namespace pelorus
