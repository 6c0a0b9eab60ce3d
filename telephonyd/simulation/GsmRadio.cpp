#include "telephonyd/simulation/GsmRadio.h"

#include <algorithm>

namespace pelorus {

namespace {

/// 41 dBm and 15 dB of antenna, and 8 dB less of path loss than at 2 GHz.
constexpr double kPower = 41.0 + 15.0 + 8.0;
constexpr double kFilterMemory = 2.0; // seconds
constexpr double kLowest = -110.0;    // range of RXLEV (3GPP TS 45.008, 8.1.4)
constexpr double kHighest = -47.0;
constexpr double kLowestFound = -104.0;

std::vector<Antenna> antennas()
{
    return antennasOf(kGsmCells, [](const GsmCell&) { return kPower; });
}

} // namespace

GsmRadio::GsmRadio(Point where, Random& random) : field(antennas(), where, random)
{
    measure(1.0);
}

void GsmRadio::measure(double gain)
{
    for (std::size_t cell = 0; cell < kGsmCellCount; ++cell) {
        levels[cell] = std::clamp(field.level(cell), kLowest, kHighest);
        averages[cell] += gain * (levels[cell] - averages[cell]);
    }
}

void GsmRadio::advance(const Journey& journey, double seconds, Random& random)
{
    field.advance(journey, random);
    measure(1.0 - std::exp(-seconds / kFilterMemory));
}

std::size_t GsmRadio::best() const
{
    return static_cast<std::size_t>(std::max_element(averages.begin(), averages.end()) - averages.begin());
}

bool GsmRadio::isFound(std::size_t cell) const
{
    return averages[cell] > kLowestFound;
}

RankedGsmCells GsmRadio::neighbours(std::size_t without, std::size_t most) const
{
    RankedGsmCells found;
    for (std::size_t cell = 0; cell < kGsmCellCount; ++cell)
        if (cell != without && isFound(cell))
            found.add(cell, averages[cell]);
    found.limit(most);
    return found;
}

} // namespace pelorus
