#pragma once

#include "telephonyd/simulation/Handset.h"

#include <memory>
#include <string_view>

namespace pelorus {

/// The endless story of one handset: the same messages for the same seed, but for their time stamps.
class Simulation {
public:
    /// Null when there is no simulated handset of that technology. The time stamps count from `start`.
    static std::unique_ptr<Simulation> create(std::string_view technology, std::uint64_t seed,
                                              HandsetTime start);

    /// The next message, with its time as the handset lives it. Valid until the next call.
    void next(SimulatedMessage& message);

private:
    Simulation(std::unique_ptr<Handset> player, HandsetTime start) : handset(std::move(player)), batch(start)
    {}

    std::unique_ptr<Handset> handset;
    MessageBatch batch;
    std::size_t taken = 0; // of the batch
};

} // namespace pelorus
