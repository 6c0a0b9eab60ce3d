#include "LogGenerator/Osprey/Format.h"

#include <fmt/format.h>

namespace pelorus {

namespace {

/// value / Format::kOne in units of 1 / `unit`, without its sign; halves to even. The unit is a constant so
/// that the divisions are none.
template <std::uint64_t unit> std::uint64_t rounded(std::int64_t value)
{
    constexpr std::uint64_t kDivisor = Format::kOne / unit;
    const auto bits = static_cast<std::uint64_t>(value);
    const std::uint64_t magnitude = value < 0 ? 0 - bits : bits;
    const std::uint64_t quotient = magnitude / kDivisor;
    const std::uint64_t twiceTheRest = magnitude % kDivisor * 2;
    return quotient + (twiceTheRest > kDivisor || (twiceTheRest == kDivisor && quotient % 2 == 1) ? 1 : 0);
}

} // namespace

void Format::write(std::string& out, std::int64_t value) const
{
    const auto low = static_cast<std::uint32_t>(value);
    const bool negative = !isUnsigned && static_cast<std::int32_t>(low) < 0;
    const std::uint32_t magnitude = negative ? 0 - low : low;
    if (magnitude >= PackedText::kDigitsEnd || !leavesRoomFor(9)) [[unlikely]]
        return writeLong(out, fmt::format("{}{}", negative ? "-" : "", magnitude));
    PackedText text = prefix;
    if (negative)
        text.append('-', 1);
    text.appendNumber(magnitude);
    text.append(suffix);
    text.storeInto(out);
}

void Format::writeFixed(std::string& out, std::int64_t value) const
{
    constexpr std::uint64_t kPackedWhole = 10'000;
    const std::uint64_t unit = hasSixDecimals ? 1'000'000 : 100;
    const std::uint64_t parts = hasSixDecimals ? rounded<1'000'000>(value) : rounded<100>(value);
    if (parts >= kPackedWhole * unit || !leavesRoomFor(hasSixDecimals ? 12 : 8)) [[unlikely]]
        return writeLong(out, fmt::format("{}{}.{:0{}}", value < 0 ? "-" : "", parts / unit, parts % unit,
                                          hasSixDecimals ? 6 : 2));
    PackedText text = prefix;
    if (value < 0)
        text.append('-', 1);
    if (hasSixDecimals) {
        text.appendNumber(static_cast<std::uint32_t>(parts / 1'000'000));
        text.appendMillionths(static_cast<std::uint32_t>(parts % 1'000'000));
    } else {
        text.appendNumber(static_cast<std::uint32_t>(parts) / 100);
        text.appendHundredths(static_cast<std::uint32_t>(parts) % 100);
    }
    text.append(suffix);
    text.storeInto(out);
}

void Format::writeLong(std::string& out, std::string_view number) const
{
    std::string end;
    prefix.storeInto(out);
    suffix.storeInto(end);
    out.append(number).append(end);
}

} // namespace pelorus
