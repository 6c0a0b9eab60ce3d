#include "telephonyd/simulation/RadioField.h"

#include <algorithm>
#include <cmath>

namespace pelorus {

namespace {

// Urban macro cells at 2 GHz (3GPP TR 36.942, 4.5.2), the handset in a car.
constexpr double kLossAtOneKilometre = 128.1;
constexpr double kLossPerOctave = 37.6 * 0.30103;
constexpr double kCarLoss = 8.0;
constexpr double kSmallestDistance = 35.0; // the road does not climb the mast
constexpr double kFrontToBack = 22.0;      // dB
constexpr double kShadowDeviation = 5.5;   // dB, of the site's and the cell's part each
constexpr double kShadowMemory = 50.0;     // metres
constexpr double kFadingDeviation = 1.2;   // dB, what is left of fast fading in one measurement

} // namespace

std::vector<Drift> drifts(std::size_t count, Random& random)
{
    std::vector<Drift> result;
    result.reserve(count);
    for (std::size_t i = 0; i < count; ++i)
        result.emplace_back(random);
    return result;
}

RadioField::RadioField(std::vector<Antenna> cells, Point where, Random& random)
    : antennas(std::move(cells)), siteShadows(drifts(kSiteCount, random)),
      cellShadows(drifts(antennas.size(), random)), levels(antennas.size())
{
    measure(where, random);
}

void RadioField::measure(Point where, Random& random)
{
    for (std::size_t site = 0; site < kSiteCount; ++site) {
        const double east = where.x - kSites[site].x;
        const double north = where.y - kSites[site].y;
        const double metres = std::max(std::sqrt(east * east + north * north), kSmallestDistance);
        views[site] = {metres, kLossAtOneKilometre + kCarLoss + kLossPerOctave * std::log2(metres / 1000.0),
                       east / metres, north / metres};
    }
    for (std::size_t cell = 0; cell < antennas.size(); ++cell) {
        const Antenna& antenna = antennas[cell];
        const SiteView& view = views[antenna.site];
        const double ahead = antenna.eastward * view.eastward + antenna.northward * view.northward;
        const double shadow = kShadowDeviation * (siteShadows[antenna.site].now() + cellShadows[cell].now());
        levels[cell] = antenna.power - view.loss - kFrontToBack * 0.5 * (1.0 - ahead) + shadow * 0.7071 +
                       kFadingDeviation * random.normal();
    }
}

void RadioField::advance(const Journey& journey, Random& random)
{
    if (journey.moved() > 0) {
        const Fading shadow(journey.moved(), kShadowMemory);
        for (Drift& drift : siteShadows)
            drift.advance(shadow, random);
        for (Drift& drift : cellShadows)
            drift.advance(shadow, random);
    }
    measure(journey.position(), random);
}

} // namespace pelorus
