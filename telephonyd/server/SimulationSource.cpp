#include "telephonyd/server/SimulationSource.h"

#include <fmt/format.h>

namespace pelorus {

SourceFactory SimulationSource::factory(std::string technology, std::uint64_t seed)
{
    return [technology = std::move(technology), seed](std::string& why) -> std::unique_ptr<MessageSource> {
        auto simulation = Simulation::create(technology, seed, std::chrono::system_clock::now());
        if (!simulation) {
            why = fmt::format("there is no simulated handset of the technology \"{}\"", technology);
            return nullptr;
        }
        return std::make_unique<SimulationSource>(std::move(simulation));
    };
}

bool SimulationSource::next(SourceMessage& message)
{
    SimulatedMessage simulated;
    simulation->next(simulated);
    message = {simulated.time, simulated.bytes};
    return true;
}

} // namespace pelorus
