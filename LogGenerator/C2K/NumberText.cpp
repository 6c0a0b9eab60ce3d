#include "LogGenerator/C2K/NumberText.h"

#include <cmath>
#include <fmt/format.h>

namespace pelorus {

void NumberText::write(std::string& out, std::int64_t value) const
{
    const auto low = static_cast<std::int32_t>(value);
    const std::uint32_t magnitude =
        low < 0 ? 0 - static_cast<std::uint32_t>(low) : static_cast<std::uint32_t>(low);
    if (isHexadecimal)
        return writeAround(out, fmt::format("{:06x}", static_cast<std::uint32_t>(low)));
    if (!isPacked || magnitude >= kPackedEnd) [[unlikely]]
        return writeAround(out, fmt::format("{}{}", signOf(low < 0), magnitude));
    PackedText text(signOf(low < 0));
    text.appendNumber(magnitude);
    finish(out, text);
}

void NumberText::write(std::string& out, double value) const
{
    constexpr double kTieWidth = 1e-6; // wider than what multiplying by 100 may lose
    const double scaled = std::fabs(value) * 100.0;
    const double rest = scaled - std::floor(scaled);
    // Near a tie the exact decimal expansion decides; that, and what is no number, is left to the library.
    if (!isPacked || !(scaled < kPackedEnd * 100.0 - 1) || std::fabs(rest - 0.5) < kTieWidth) [[unlikely]]
        return writeAround(out, showsPlus ? fmt::format("{:+.2f}", value) : fmt::format("{:.2f}", value));
    const auto hundredths = static_cast<std::uint32_t>(scaled) + (rest > 0.5 ? 1U : 0U);
    PackedText text(signOf(std::signbit(value)));
    text.appendNumber(hundredths / 100);
    text.appendHundredths(hundredths % 100);
    finish(out, text);
}

void NumberText::finish(std::string& out, PackedText number) const
{
    number.append(packedAfter);
    number.storeInto(out);
    if (!before.empty())
        out.insert(0, before);
}

void NumberText::writeAround(std::string& out, std::string_view number) const
{
    out.assign(before).append(number).append(after);
}

} // namespace pelorus
