#include "telephonyd/simulation/SoftHandover.h"

#include <algorithm>

namespace pelorus {

namespace {

// dB
constexpr double kJoinWithin = 4.0;
constexpr double kLeaveBehind = 6.0;
constexpr double kReplaceBetter = 1.5;

} // namespace

void SoftHandover::reset(std::size_t cell)
{
    cells[0] = cell;
    count = 1;
    joining.reset();
    leaving.reset();
}

bool SoftHandover::contains(std::size_t cell) const
{
    return std::find(begin(), end(), cell) != end();
}

std::size_t SoftHandover::best(const UmtsRadio& radio) const
{
    return *std::max_element(begin(), end(), [&radio](std::size_t a, std::size_t b) {
        return radio[a].averageEcio < radio[b].averageEcio;
    });
}

std::size_t SoftHandover::worst(const UmtsRadio& radio) const
{
    return *std::min_element(begin(), end(), [&radio](std::size_t a, std::size_t b) {
        return radio[a].averageEcio < radio[b].averageEcio;
    });
}

void SoftHandover::remove(std::size_t cell)
{
    const auto end = std::remove(cells.begin(), cells.begin() + static_cast<std::ptrdiff_t>(count), cell);
    count = static_cast<std::size_t>(end - cells.begin());
}

void SoftHandover::update(const UmtsRadio& radio, double seconds)
{
    const double top = radio[best(radio)].averageEcio;
    const std::size_t last = worst(radio);
    const double bar = count < kMost ? top - kJoinWithin
                                     : std::max(top - kJoinWithin, radio[last].averageEcio + kReplaceBetter);
    std::optional<std::size_t> candidate;
    for (std::size_t cell = 0; cell < kUmtsCellCount; ++cell)
        if (!contains(cell) && radio.isDetected(cell) && radio[cell].averageEcio > bar &&
            (!candidate || radio[cell].averageEcio > radio[*candidate].averageEcio))
            candidate = cell;
    if (joining.holds(candidate, seconds)) {
        if (count == kMost)
            remove(last);
        cells[count++] = *candidate;
        joining.reset();
        return;
    }
    const bool isBehind = count > 1 && radio[last].averageEcio < top - kLeaveBehind;
    if (leaving.holds(isBehind ? std::optional(last) : std::nullopt, seconds)) {
        remove(last);
        leaving.reset();
    }
}

} // namespace pelorus
