#include "LogGenerator/GSM/GSMLogGenerator.h"

namespace pelorus {

std::unique_ptr<GSMLogGenerator> GSMLogGenerator::generator(Platform& platform)
{
    return std::make_unique<GSMLogGenerator>(platform);
}

GSMLogGenerator::GSMLogGenerator(Platform& system) : LogGenerator(system)
{
    init();
}

void GSMLogGenerator::updateState(State& state, std::span<const std::byte>)
{
    adoptState(state, "IFX");
}

Value GSMLogGenerator::generateLogUsingState(State& state)
{
    adoptState(state, "IFX");
    updateHistoryInState(platform, state);
    return state.at("Display");
}

Value GSMLogGenerator::getStartCommand() const
{
    return makeDictionary({{"SetState", "Streaming"}});
}

std::shared_ptr<Array> GSMLogGenerator::getSaveContentsFromState(const State& state) const
{
    return historyOf(state);
}

} // namespace pelorus
