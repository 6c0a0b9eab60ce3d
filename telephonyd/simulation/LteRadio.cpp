#include "telephonyd/simulation/LteRadio.h"

#include "telephonyd/simulation/Decibels.h"

#include <algorithm>

namespace pelorus {

namespace {

/// 43 dBm over 1200 subcarriers, 15 dB of antenna.
constexpr double kPowerPerSubcarrier = 43.0 - 30.8 + 15.0;
constexpr double kNoisePerSubcarrier = -132.2 + 7.0; // 15 kHz of thermal noise and of the receiver's own
constexpr double kLoadMean = 0.35;
constexpr double kLoadDeviation = 0.18;
constexpr double kLoadMemory = 20.0; // seconds
/// Of an idle cell's subcarriers, those that its reference signals take in the symbols that are measured.
constexpr double kReferenceSignals = 1.0 / 6.0;

// Reportable range (3GPP TS 36.133, 9.1.4).
constexpr double kLowestRsrp = -140.0;
constexpr double kHighestRsrp = -44.0;

std::vector<Antenna> antennas()
{
    return antennasOf(kLteCells, [](const LteCell& cell) {
        return kPowerPerSubcarrier - kLteCarriers[cell.carrier].extraLoss;
    });
}

} // namespace

LteRadio::LteRadio(Point where, Random& random)
    : field(antennas(), where, random), loads(drifts(kLteCellCount, random))
{
    measure();
    average(1.0);
}

void LteRadio::measure()
{
    std::array<double, kLteCarrierCount> power;
    power.fill(milliwatts(kNoisePerSubcarrier));
    for (std::size_t i = 0; i < kLteCellCount; ++i) {
        const LteCell& cell = kLteCells[i];
        measurements[i].rsrp = std::clamp(field.level(i), kLowestRsrp, kHighestRsrp);
        const double load = std::clamp(kLoadMean + kLoadDeviation * loads[i].now(), 0.02, 1.0);
        power[cell.carrier] +=
            milliwatts(measurements[i].rsrp) * (kReferenceSignals + (1.0 - kReferenceSignals) * load);
    }
    for (std::size_t carrier = 0; carrier < kLteCarrierCount; ++carrier)
        carrierRssi[carrier] = decibels(power[carrier] * 12.0 * kLteCarriers[carrier].resourceBlocks);
    std::array<double, kLteCarrierCount> perResourceBlock;
    for (std::size_t carrier = 0; carrier < kLteCarrierCount; ++carrier)
        perResourceBlock[carrier] = carrierRssi[carrier] - decibels(kLteCarriers[carrier].resourceBlocks);
    for (std::size_t i = 0; i < kLteCellCount; ++i)
        measurements[i].rsrq = measurements[i].rsrp - perResourceBlock[kLteCells[i].carrier];
}

void LteRadio::average(double gain)
{
    for (LteMeasurement& cell : measurements) {
        cell.averageRsrp += gain * (cell.rsrp - cell.averageRsrp);
        cell.averageRsrq += gain * (cell.rsrq - cell.averageRsrq);
    }
}

void LteRadio::advance(const Journey& journey, double seconds, double gain, Random& random)
{
    field.advance(journey, random);
    const Fading load(seconds, kLoadMemory);
    for (Drift& drift : loads)
        drift.advance(load, random);
    measure();
    average(gain);
}

} // namespace pelorus
