#pragma once

#include "telephonyd/simulation/LteRadio.h"

#include <algorithm>

namespace pelorus {

/// Cells of one carrier without the serving one, the strongest first.
class LteCellList {
public:
    /// Those whose RSRQ is at least `lowest` and below `highest`. A receiver finds a cell in the noise of the
    /// others, so that counts here and not its level.
    LteCellList(const LteRadio& radio, std::size_t serving, std::size_t carrier, double lowest,
                double highest = 100);

    void limit(std::size_t most) { count = std::min(count, most); }
    std::size_t size() const { return count; }
    bool empty() const { return count == 0; }
    std::size_t front() const { return cells[0]; }
    const std::size_t* begin() const { return cells.data(); }
    const std::size_t* end() const { return cells.data() + count; }

private:
    std::array<std::size_t, kLteCellCount> cells{};
    std::size_t count = 0;
};

/// Lowest RSRQ that is reported (3GPP TS 36.133, 9.1.7), and the lowest at which a cell is still noticed.
constexpr double kLowestReportedRsrq = -19.5;
constexpr double kLowestNoticedRsrq = -23.0;

} // namespace pelorus
