// One refresh, display tree and history, on a full LTE display.

#include "LogGenerator/LogGenerator.h"
#include "bench/MessageStream.h"
#include "model/PelorusModelNode.h"
#include "platform/scripted/ScriptedPlatform.h"

#include <benchmark/benchmark.h>

namespace {

using namespace pelorus;

/// A report of the longest lists that a handset makes: 32 neighbours, 16 measured and 8 detected cells, 8
/// candidates.
std::vector<std::byte> packet(std::uint16_t code, std::size_t length)
{
    std::vector<std::byte> bytes(length);
    bytes[0] = std::byte{1};
    bytes[3] = static_cast<std::byte>(code);
    bytes[4] = static_cast<std::byte>(code >> 8);
    for (std::size_t place = 13; place < length; ++place)
        bytes[place] = static_cast<std::byte>(place * 37);
    return bytes;
}

void refresh(benchmark::State& run)
{
    ScriptedPlatform platform;
    platform.useResourceDirectory(PELORUS_SOURCE_DIR "/resources");
    const auto generator = LogGenerator::generatorFromTechnology(platform, "Osprey LTE");
    State state;
    const bench::MessageStream stream("Osprey LTE", 20'000);
    for (std::size_t index = 0; index < stream.size(); ++index)
        generator->updateState(state, stream[index]);
    auto neighbours = packet(0xB180, 21 + 32 * 20);
    neighbours[19] = std::byte{0xC0};
    neighbours[20] = std::byte{0x07};
    generator->updateState(state, neighbours);
    auto measured = packet(0xB179, 29 + 16 * 6 + 8 * 2);
    measured[27] = std::byte{16};
    measured[28] = std::byte{8};
    generator->updateState(state, measured);
    auto candidates = packet(0xB186, 21 + 8 * 4);
    candidates[19] = std::byte{8};
    candidates[20] = std::byte{0};
    generator->updateState(state, candidates);

    std::size_t nodes = 0;
    for ([[maybe_unused]] auto _ : run) {
        generator->updateState(state, measured);
        PathDictionary paths;
        const auto root =
            PelorusModelNode::makeTreeFromObject(generator->generateLogUsingState(state), paths);
        benchmark::DoNotOptimize(root.get());
        nodes = paths.size();
    }
    run.counters["nodes"] = static_cast<double>(nodes);
}
BENCHMARK(refresh)->Unit(benchmark::kMicrosecond);

} // namespace

BENCHMARK_MAIN();
