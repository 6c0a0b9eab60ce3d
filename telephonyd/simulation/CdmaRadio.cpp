#include "telephonyd/simulation/CdmaRadio.h"

#include "telephonyd/simulation/Decibels.h"

#include <algorithm>

namespace pelorus {

namespace {

/// 43 dBm at full power and 15 dB of antenna, less 15 dB of feeders and of the pocket that it is in.
constexpr double kFullPower = 43.0 + 15.0 - 15.0;
constexpr double kCdmaPilotShare = -7.0;    // dB of full power
constexpr double kLowerBand = 8.0;          // dB less of path loss at 800 MHz than at 1.9 GHz
constexpr double kNoise = -113.0 + 8.0;     // 1.25 MHz of thermal noise and of the receiver's own
constexpr double kReceiverRatio = 14.0;     // dB, the best C/I that a receiver with its own errors sees
constexpr double kOwnDispersion = 0.04;     // share of a sector's power that its echoes turn into noise
constexpr double kDiversityDeviation = 2.5; // dB
constexpr double kDiversityMemory = 2.0;    // seconds
/// Power of a sector over that of its 1x pilot: other common channels, and traffic at full load.
constexpr double kCommonChannels = 1.6;
constexpr double kTraffic = 3.2;
constexpr double kLoadMean = 0.45;
constexpr double kLoadDeviation = 0.2;
constexpr double kLoadMemory = 20.0; // seconds
constexpr double kFilterMemory = 0.5;
constexpr double kLowestStrength = -24.0; // what a searcher tells from noise
constexpr double kLowestLevel = -105.0;
constexpr double kHighestLevel = -25.0;

std::vector<Antenna> antennas()
{
    return antennasOf(kCdmaSectors, [](const CdmaSector&) { return kFullPower; });
}

} // namespace

std::size_t CdmaCarrier::best() const
{
    return static_cast<std::size_t>(std::max_element(averages.begin(), averages.end()) - averages.begin());
}

CdmaRadio::CdmaRadio(Point where, Random& random)
    : field(antennas(), where, random), loads(drifts(kCdmaSectorCount, random)), diversity(random)
{
    measure();
    average(1.0);
}

void CdmaRadio::measure()
{
    CdmaCarrier::PerSector pilots{};
    CdmaCarrier::PerSector bursts{};
    double cdmaPower = milliwatts(kNoise);
    double evdoPower = milliwatts(kNoise);
    for (std::size_t sector = 0; sector < kCdmaSectorCount; ++sector) {
        bursts[sector] = milliwatts(field.level(sector));
        pilots[sector] = bursts[sector] * milliwatts(kCdmaPilotShare + kLowerBand);
        const double load = std::clamp(kLoadMean + kLoadDeviation * loads[sector].now(), 0.05, 1.0);
        cdmaPower += pilots[sector] * (kCommonChannels + kTraffic * load);
        evdoPower += bursts[sector];
    }
    const double limit = 1.0 / milliwatts(kReceiverRatio);
    for (std::size_t sector = 0; sector < kCdmaSectorCount; ++sector) {
        cdmaCarrier.strengths[sector] = std::max(decibels(pilots[sector] / cdmaPower), kLowestStrength);
        evdoCarrier.strengths[sector] = std::max(decibels(bursts[sector] / evdoPower), kLowestStrength);
        const double others = evdoPower - bursts[sector] * (1.0 - kOwnDispersion);
        evdoCarrier.ratios[sector] = -decibels(others / bursts[sector] + limit);
    }
    const auto level = [](double dBm) { return std::clamp(dBm, kLowestLevel, kHighestLevel); };
    const double other = kDiversityDeviation * diversity.now();
    cdmaCarrier.levels = {level(decibels(cdmaPower)), level(decibels(cdmaPower) + other)};
    evdoCarrier.levels = {level(decibels(evdoPower)), level(decibels(evdoPower) + other)};
}

void CdmaRadio::average(double gain)
{
    for (CdmaCarrier* carrier : {&cdmaCarrier, &evdoCarrier})
        for (std::size_t sector = 0; sector < kCdmaSectorCount; ++sector)
            carrier->averages[sector] += gain * (carrier->strengths[sector] - carrier->averages[sector]);
}

void CdmaRadio::advance(const Journey& journey, double seconds, Random& random)
{
    field.advance(journey, random);
    const Fading load(seconds, kLoadMemory);
    for (Drift& drift : loads)
        drift.advance(load, random);
    diversity.advance(Fading(seconds, kDiversityMemory), random);
    measure();
    average(1.0 - std::exp(-seconds / kFilterMemory));
}

} // namespace pelorus
