#pragma once

#include "telephonyd/simulation/LteNetwork.h"

namespace pelorus {

/// What the handset's receiver makes of one cell. Levels in dBm, RSRQ in dB.
struct LteMeasurement {
    double rsrp = 0;
    double rsrq = 0;
    double averageRsrp = 0; // filtered over time
    double averageRsrq = 0;
};

/// The radio field around the handset. Path loss grows with distance and behind the antennas; houses cast
/// shadows that change over tens of metres, the same ones for all cells of a site; what is left fades from
/// one measurement to the next. Cells of one carrier are each other's interference, as far as they carry
/// traffic.
class LteRadio {
public:
    LteRadio(Point where, Random& random);

    /// `gain` of the averages is how much a new measurement counts in them.
    void advance(const Journey& journey, double seconds, double gain, Random& random);

    const LteMeasurement& operator[](std::size_t cell) const { return measurements[cell]; }
    /// Of the whole bandwidth, dBm.
    double rssi(std::size_t carrier) const { return carrierRssi[carrier]; }
    /// Metres to the site.
    double distance(std::size_t cell) const { return distances[kLteCells[cell].site]; }

private:
    struct SiteView {
        double loss; // dB
        double eastward;
        double northward;
    };

    SiteView see(std::size_t site, Point from);
    void measure(Point where, Random& random);
    void average(double gain);

    std::vector<Drift> siteShadows;
    std::vector<Drift> cellShadows;
    std::vector<Drift> loads;
    std::array<double, kLteSiteCount> distances{};
    std::array<double, kLteCarrierCount> carrierRssi{};
    std::array<LteMeasurement, kLteCellCount> measurements{};
};

} // namespace pelorus
