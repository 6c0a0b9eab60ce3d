#pragma once

#include "telephonyd/simulation/Drift.h"
#include "telephonyd/simulation/Town.h"

#include <cstdint>
#include <vector>

namespace pelorus {

/// A cell's antenna: where it stands, where it looks (a unit vector), and the power ahead of it, in dBm at
/// 0 dB of path loss.
struct Antenna {
    std::uint8_t site; // index of kSites
    double eastward;
    double northward;
    double power;
};

/// Those of all cells of a network; `power` gives a cell's, in the antenna's unit.
template <class Cells, class Power> std::vector<Antenna> antennasOf(const Cells& cells, Power power)
{
    std::vector<Antenna> antennas;
    antennas.reserve(cells.size());
    for (const auto& cell : cells)
        antennas.push_back({cell.site, cell.eastward, cell.northward, power(cell)});
    return antennas;
}

/// The levels of cells as they reach a car. Path loss grows with distance and behind the antennas; houses
/// cast shadows that change over tens of metres, half of it the same for all cells of a site; what is left
/// fades from one measurement to the next.
class RadioField {
public:
    RadioField(std::vector<Antenna> cells, Point where, Random& random);

    void advance(const Journey& journey, Random& random);

    std::size_t size() const { return antennas.size(); }
    /// In dBm.
    double level(std::size_t cell) const { return levels[cell]; }
    /// Metres to the site.
    double distance(std::size_t site) const { return views[site].metres; }

private:
    struct SiteView {
        double metres = 0;
        double loss = 0; // dB
        double eastward = 0;
        double northward = 0;
    };

    void measure(Point where, Random& random);

    std::vector<Antenna> antennas;
    std::vector<Drift> siteShadows;
    std::vector<Drift> cellShadows;
    std::array<SiteView, kSiteCount> views;
    std::vector<double> levels;
};

/// That many values that wander each for itself.
std::vector<Drift> drifts(std::size_t count, Random& random);

} // namespace pelorus
