#pragma once

#include "telephonyd/simulation/RadioField.h"
#include "telephonyd/simulation/RankedCells.h"
#include "telephonyd/simulation/UtranNetwork.h"

namespace pelorus {

/// What the handset receives of the beacon (P-CCPCH) of each cell.
class UtranRadio {
public:
    UtranRadio(Point where, Random& random);

    void advance(const Journey& journey, double seconds, Random& random);

    /// RSCP in dBm, filtered over time.
    double rscp(std::size_t cell) const { return averages[cell]; }
    /// Of the cell's timeslots to what else is on its frequency, in dB, as measured just now.
    double interferenceRatio(std::size_t cell) const;
    std::size_t best() const;
    bool isDetected(std::size_t cell) const;

private:
    void measure(double gain);

    RadioField field;
    std::array<double, kUtranCellCount> levels{};
    std::array<double, kUtranCellCount> averages{};
};

} // namespace pelorus
