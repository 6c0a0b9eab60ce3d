#pragma once

#include "telephonyd/simulation/TimeToTrigger.h"
#include "telephonyd/simulation/UmtsRadio.h"

namespace pelorus {

/// The cells that a UMTS handset is connected to at once, the active set. One in idle mode.
class SoftHandover {
public:
    static constexpr std::size_t kMost = 3;

    void reset(std::size_t cell);
    /// The network answers the handset's measurement reports (3GPP TS 25.331, 14.1.2): a cell that comes
    /// close to the best one joins (event 1a), one that falls behind leaves (1b), a better one takes the
    /// place of the worst (1c).
    void update(const UmtsRadio& radio, double seconds);

    bool contains(std::size_t cell) const;
    std::size_t best(const UmtsRadio& radio) const;
    std::size_t size() const { return count; }
    const std::size_t* begin() const { return cells.data(); }
    const std::size_t* end() const { return cells.data() + count; }

private:
    std::size_t worst(const UmtsRadio& radio) const;
    void remove(std::size_t cell);

    std::array<std::size_t, kMost> cells{};
    std::size_t count = 0;
    TimeToTrigger joining{0.32};
    TimeToTrigger leaving{0.64};
};

} // namespace pelorus
