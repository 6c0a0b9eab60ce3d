#include "telephonyd/simulation/UmtsRadio.h"

#include "telephonyd/simulation/Decibels.h"

#include <algorithm>

namespace pelorus {

namespace {

/// 30 dBm of pilot and 15 dB of antenna, less 15 dB of feeders, glazing and of the pocket that it is in.
constexpr double kPilotPower = 30.0 + 15.0 - 15.0;
constexpr double kNoise = -108.0 + 8.0; // 3.84 MHz of thermal noise and of the receiver's own
/// Power of a cell over that of its pilot: other common channels, and traffic at full load.
constexpr double kCommonChannels = 2.2;
constexpr double kTraffic = 7.5;
constexpr double kLoadMean = 0.35;
constexpr double kLoadDeviation = 0.18;
constexpr double kLoadMemory = 20.0; // seconds
constexpr double kFilterMemory = 0.5;
// Reportable range of the RSCP (3GPP TS 25.133, 9.1.1.3), and what can still be found of a pilot.
constexpr double kLowestRscp = -120.0;
constexpr double kHighestRscp = -40.0;
constexpr double kLowestEcio = -18.0;

std::vector<Antenna> antennas()
{
    return antennasOf(kUmtsCells, [](const UmtsCell&) { return kPilotPower; });
}

} // namespace

UmtsRadio::UmtsRadio(Point where, Random& random)
    : field(antennas(), where, random), loads(drifts(kUmtsCellCount, random))
{
    measure();
    average(1.0);
}

void UmtsRadio::measure()
{
    double power = milliwatts(kNoise);
    for (std::size_t cell = 0; cell < kUmtsCellCount; ++cell) {
        measurements[cell].rscp = std::clamp(field.level(cell), kLowestRscp, kHighestRscp);
        const double load = std::clamp(kLoadMean + kLoadDeviation * loads[cell].now(), 0.02, 1.0);
        power += milliwatts(measurements[cell].rscp) * (kCommonChannels + kTraffic * load);
    }
    carrierRssi = decibels(power);
    for (UmtsMeasurement& cell : measurements)
        cell.ecio = cell.rscp - carrierRssi;
}

void UmtsRadio::average(double gain)
{
    for (UmtsMeasurement& cell : measurements) {
        cell.averageRscp += gain * (cell.rscp - cell.averageRscp);
        cell.averageEcio += gain * (cell.ecio - cell.averageEcio);
    }
}

void UmtsRadio::advance(const Journey& journey, double seconds, Random& random)
{
    field.advance(journey, random);
    const Fading load(seconds, kLoadMemory);
    for (Drift& drift : loads)
        drift.advance(load, random);
    measure();
    average(1.0 - std::exp(-seconds / kFilterMemory));
}

std::size_t UmtsRadio::best() const
{
    std::size_t found = 0;
    for (std::size_t cell = 1; cell < kUmtsCellCount; ++cell)
        if (measurements[cell].averageRscp > measurements[found].averageRscp)
            found = cell;
    return found;
}

bool UmtsRadio::isDetected(std::size_t cell) const
{
    return measurements[cell].averageEcio > kLowestEcio && measurements[cell].averageRscp > kLowestRscp + 4;
}

} // namespace pelorus
