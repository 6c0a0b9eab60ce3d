#include "LogGenerator/C2K/C2KLogGenerator.h"

namespace pelorus {

std::unique_ptr<C2KLogGenerator> C2KLogGenerator::generator(Platform& platform)
{
    return std::make_unique<C2KLogGenerator>(platform);
}

C2KLogGenerator::C2KLogGenerator(Platform& system) : OSPLogGenerator(system)
{
    init();
}

void C2KLogGenerator::updateState(State& state, std::span<const std::byte>)
{
    adoptState(state, "C2K");
}

Value C2KLogGenerator::generateLogUsingState(State& state)
{
    adoptState(state, "C2K");
    handOverRawMessages(state);
    updateHistoryInState(platform, state);
    return state.at("Display");
}

Value C2KLogGenerator::getStartCommand() const
{
    return makeDictionary({{"SetState", "Streaming"}, {"SetOspreyLogCodes", makeArray()}});
}

} // namespace pelorus
