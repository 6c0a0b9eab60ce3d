#include "telephonyd/simulation/LteRadio.h"

#include <algorithm>
#include <cmath>

namespace pelorus {

namespace {

// Urban macro cells at 2 GHz (3GPP TR 36.942, 4.5.2), the handset in a car.
constexpr double kLossAtOneKilometre = 128.1;
constexpr double kLossPerOctave = 37.6 * 0.30103;
constexpr double kCarLoss = 8.0;
constexpr double kSmallestDistance = 35.0; // the road does not climb the mast
/// 43 dBm over 1200 subcarriers, 15 dB of antenna.
constexpr double kPowerPerSubcarrier = 43.0 - 30.8 + 15.0;
constexpr double kFrontToBack = 22.0;                // dB
constexpr double kShadowDeviation = 5.5;             // dB, of the site's and the cell's part each
constexpr double kShadowMemory = 50.0;               // metres
constexpr double kFadingDeviation = 1.2;             // dB, what is left of fast fading in one measurement
constexpr double kNoisePerSubcarrier = -132.2 + 7.0; // 15 kHz of thermal noise and of the receiver's own
constexpr double kLoadMean = 0.35;
constexpr double kLoadDeviation = 0.18;
constexpr double kLoadMemory = 20.0; // seconds
/// Of an idle cell's subcarriers, those that its reference signals take in the symbols that are measured.
constexpr double kReferenceSignals = 1.0 / 6.0;

// Reportable range (3GPP TS 36.133, 9.1.4).
constexpr double kLowestRsrp = -140.0;
constexpr double kHighestRsrp = -44.0;

double milliwatts(double dBm)
{
    return std::exp2(dBm * 0.33219281);
}

double decibels(double ratio)
{
    return 3.01029996 * std::log2(ratio);
}

std::vector<Drift> drifts(std::size_t count, Random& random)
{
    std::vector<Drift> result;
    result.reserve(count);
    for (std::size_t i = 0; i < count; ++i)
        result.emplace_back(random);
    return result;
}

} // namespace

LteRadio::LteRadio(Point where, Random& random)
    : siteShadows(drifts(kLteSiteCount, random)), cellShadows(drifts(kLteCellCount, random)),
      loads(drifts(kLteCellCount, random))
{
    measure(where, random);
    average(1.0);
}

LteRadio::SiteView LteRadio::see(std::size_t site, Point from)
{
    const double east = from.x - kLteSites[site].x;
    const double north = from.y - kLteSites[site].y;
    const double metres = std::max(std::sqrt(east * east + north * north), kSmallestDistance);
    distances[site] = metres;
    return {kLossAtOneKilometre + kCarLoss + kLossPerOctave * std::log2(metres / 1000.0), east / metres,
            north / metres};
}

void LteRadio::measure(Point where, Random& random)
{
    std::array<SiteView, kLteSiteCount> views;
    for (std::size_t site = 0; site < kLteSiteCount; ++site)
        views[site] = see(site, where);

    std::array<double, kLteCarrierCount> power;
    power.fill(milliwatts(kNoisePerSubcarrier));
    for (std::size_t i = 0; i < kLteCellCount; ++i) {
        const LteCell& cell = kLteCells[i];
        const SiteView& view = views[cell.site];
        const double ahead = cell.eastward * view.eastward + cell.northward * view.northward;
        const double shadow = kShadowDeviation * (siteShadows[cell.site].now() + cellShadows[i].now());
        const double level = kPowerPerSubcarrier - view.loss - kLteCarriers[cell.carrier].extraLoss -
                             kFrontToBack * 0.5 * (1.0 - ahead) + shadow * 0.7071 +
                             kFadingDeviation * random.normal();
        measurements[i].rsrp = std::clamp(level, kLowestRsrp, kHighestRsrp);
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
    if (journey.moved() > 0) {
        const Fading shadow(journey.moved(), kShadowMemory);
        for (Drift& drift : siteShadows)
            drift.advance(shadow, random);
        for (Drift& drift : cellShadows)
            drift.advance(shadow, random);
    }
    const Fading load(seconds, kLoadMemory);
    for (Drift& drift : loads)
        drift.advance(load, random);
    measure(journey.position(), random);
    average(gain);
}

} // namespace pelorus
