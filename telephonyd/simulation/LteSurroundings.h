#pragma once

#include "telephonyd/simulation/CellMonitorList.h"
#include "telephonyd/simulation/Journey.h"
#include "telephonyd/simulation/LteReselectionCandidates.h"

#include <array>

namespace pelorus {

/// The cells of other technologies around an LTE handset, which it looks for only now and then: between two
/// searches they are as it last found them.
class LteSurroundings {
public:
    static constexpr std::size_t kCells = 6;

    void search(Point where, Random& random);
    /// As neighbours in the cell monitor's list.
    void appendTo(CellMonitorList& list) const;
    /// What an idle handset might reselect, in an order that stays the same.
    const std::vector<ReselectionCandidate>& candidates() const { return found; }

private:
    std::array<int, kCells> levels{}; // dBm
    std::vector<ReselectionCandidate> found;
};

} // namespace pelorus
