#pragma once

#include "telephonyd/simulation/CdmaRadio.h"

namespace pelorus {

/// The sectors that a CDMA handset is in handoff with, the active set. One while it is idle, none while
/// it searches.
class PilotSet {
public:
    static constexpr std::size_t kMost = 4;

    /// dB: a pilot joins above `add` (T_ADD), and leaves when it was below `drop` (T_DROP) for some seconds.
    struct Thresholds {
        double add;
        double drop;
    };

    explicit PilotSet(Thresholds limits) : thresholds(limits) {}

    void clear() { count = 0; }
    void reset(std::size_t sector);
    /// The network answers the handset's pilot strength reports. Not on an empty set.
    void update(const CdmaCarrier& carrier, double seconds);

    bool contains(std::size_t sector) const;
    /// The pilot that has been there for the longest time gives the handset its time.
    std::size_t reference() const { return members[0].sector; }
    std::size_t best(const CdmaCarrier& carrier) const;
    std::size_t size() const { return count; }
    std::size_t operator[](std::size_t index) const { return members[index].sector; }

private:
    struct Member {
        std::size_t sector = 0;
        double weakFor = 0; // seconds
    };

    void dropWeak(const CdmaCarrier& carrier, double seconds);
    void remove(std::size_t index);
    std::size_t worst(const CdmaCarrier& carrier) const;

    Thresholds thresholds;
    std::array<Member, kMost> members{};
    std::size_t count = 0;
};

} // namespace pelorus
