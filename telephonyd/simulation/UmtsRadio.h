#pragma once

#include "telephonyd/simulation/RadioField.h"
#include "telephonyd/simulation/UmtsNetwork.h"

#include <optional>

namespace pelorus {

/// What the handset's receiver makes of the common pilot of one cell: dBm and dB.
struct UmtsMeasurement {
    double rscp = 0;
    double ecio = 0;
    double averageRscp = 0; // filtered over time
    double averageEcio = 0;
};

/// What a UMTS handset receives. All cells share a frequency, and are each other's interference.
class UmtsRadio {
public:
    UmtsRadio(Point where, Random& random);

    void advance(const Journey& journey, double seconds, Random& random);

    const UmtsMeasurement& operator[](std::size_t cell) const { return measurements[cell]; }
    /// Of the whole carrier, dBm.
    double rssi() const { return carrierRssi; }
    /// The cell with the highest average.
    std::size_t best() const;
    bool isDetected(std::size_t cell) const;

private:
    void measure();
    void average(double gain);

    RadioField field;
    std::vector<Drift> loads;
    double carrierRssi = 0;
    std::array<UmtsMeasurement, kUmtsCellCount> measurements{};
};

} // namespace pelorus
