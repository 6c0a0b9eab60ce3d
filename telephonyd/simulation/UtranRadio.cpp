#include "telephonyd/simulation/UtranRadio.h"

#include "telephonyd/simulation/Decibels.h"

#include <algorithm>

namespace pelorus {

namespace {

/// 33 dBm of beacon and 15 dB of antenna, less 8 dB of feeders and of the handset in its pocket.
constexpr double kBeaconPower = 33.0 + 15.0 - 8.0;
constexpr double kNoise = -113.0 + 7.0; // 1.28 MHz of thermal noise and of the receiver's own
constexpr double kFilterMemory = 1.5;   // seconds
/// What joint detection and the other code leave of another cell's signal.
constexpr double kSuppression = 8.0; // dB
// Reportable range (3GPP TS 25.123, 9.1.1.1), and what is still noticed.
constexpr double kLowestRscp = -115.0;
constexpr double kHighestRscp = -25.0;
constexpr double kLowestDetected = -108.0;

std::vector<Antenna> antennas()
{
    return antennasOf(kUtranCells, [](const UtranCell&) { return kBeaconPower; });
}

} // namespace

UtranRadio::UtranRadio(Point where, Random& random) : field(antennas(), where, random)
{
    measure(1.0);
}

void UtranRadio::measure(double gain)
{
    for (std::size_t cell = 0; cell < kUtranCellCount; ++cell) {
        levels[cell] = std::clamp(field.level(cell), kLowestRscp, kHighestRscp);
        averages[cell] += gain * (levels[cell] - averages[cell]);
    }
}

void UtranRadio::advance(const Journey& journey, double seconds, Random& random)
{
    field.advance(journey, random);
    measure(1.0 - std::exp(-seconds / kFilterMemory));
}

double UtranRadio::interferenceRatio(std::size_t cell) const
{
    double others = milliwatts(kNoise);
    for (std::size_t other = 0; other < kUtranCellCount; ++other)
        if (other != cell && kUtranCells[other].uarfcn == kUtranCells[cell].uarfcn)
            others += milliwatts(levels[other] - kSuppression);
    return levels[cell] - decibels(others);
}

std::size_t UtranRadio::best() const
{
    return static_cast<std::size_t>(std::max_element(averages.begin(), averages.end()) - averages.begin());
}

bool UtranRadio::isDetected(std::size_t cell) const
{
    return averages[cell] > kLowestDetected;
}

} // namespace pelorus
