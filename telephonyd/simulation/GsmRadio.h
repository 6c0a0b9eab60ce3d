#pragma once

#include "telephonyd/simulation/GsmNetwork.h"
#include "telephonyd/simulation/RadioField.h"
#include "telephonyd/simulation/RankedCells.h"

namespace pelorus {

using RankedGsmCells = RankedCells<kGsmCellCount>;
constexpr std::size_t kNoGsmCell = kGsmCellCount;

/// The broadcast channels of the GSM cells as the handset receives them. Their frequencies differ, so nothing
/// but noise disturbs them.
class GsmRadio {
public:
    GsmRadio(Point where, Random& random);

    void advance(const Journey& journey, double seconds, Random& random);

    /// In dBm.
    double level(std::size_t cell) const { return levels[cell]; }
    double average(std::size_t cell) const { return averages[cell]; }
    /// The cell with the highest average.
    std::size_t best() const;
    bool isFound(std::size_t cell) const;
    /// Those found but for one, by their averages.
    RankedGsmCells neighbours(std::size_t without, std::size_t most) const;

private:
    void measure(double gain);

    RadioField field;
    std::array<double, kGsmCellCount> levels{};
    std::array<double, kGsmCellCount> averages{};
};

} // namespace pelorus
