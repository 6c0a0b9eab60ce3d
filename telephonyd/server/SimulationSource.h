#pragma once

#include "telephonyd/server/MessageSource.h"
#include "telephonyd/simulation/Simulation.h"

namespace pelorus {

/// A made-up handset, which lives for ever.
class SimulationSource : public MessageSource {
public:
    /// Every channel gets the same life.
    static SourceFactory factory(std::string technology, std::uint64_t seed);

    explicit SimulationSource(std::unique_ptr<Simulation> life) : simulation(std::move(life)) {}

    bool next(SourceMessage& message) override;
    bool rewind() override { return false; }

private:
    std::unique_ptr<Simulation> simulation;
};

} // namespace pelorus
