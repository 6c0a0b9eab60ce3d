#pragma once

#include "telephonyd/simulation/LteNetwork.h"
#include "telephonyd/simulation/RadioField.h"

namespace pelorus {

/// What the handset's receiver makes of one cell. Levels in dBm, RSRQ in dB.
struct LteMeasurement {
    double rsrp = 0;
    double rsrq = 0;
    double averageRsrp = 0; // filtered over time
    double averageRsrq = 0;
};

/// What an LTE handset receives. Cells of one carrier are each other's interference, as far as they carry
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
    double distance(std::size_t cell) const { return field.distance(kLteCells[cell].site); }

private:
    void measure();
    void average(double gain);

    RadioField field;
    std::vector<Drift> loads;
    std::array<double, kLteCarrierCount> carrierRssi{};
    std::array<LteMeasurement, kLteCellCount> measurements{};
};

} // namespace pelorus
