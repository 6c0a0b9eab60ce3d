// The mixed stream of a handset through its generator and sections, the system log off, beside what merely
// walking the framed messages takes.

#include "LogGenerator/LogGenerator.h"
#include "bench/MessageStream.h"
#include "platform/scripted/ScriptedPlatform.h"

#include <benchmark/benchmark.h>
#include <map>

namespace {

using namespace pelorus;

constexpr std::size_t kMessages = 100'000;
constexpr const char* kTechnologies[] = {"Osprey LTE", "Osprey GSM", "Osprey UTRAN2", "Osprey CDMA"};

const bench::MessageStream& streamOf(std::int64_t technology)
{
    static std::map<std::int64_t, bench::MessageStream> streams;
    const auto found = streams.find(technology);
    return found != streams.end()
               ? found->second
               : streams.emplace(technology, bench::MessageStream(kTechnologies[technology], kMessages))
                     .first->second;
}

void count(benchmark::State& run, const bench::MessageStream& stream)
{
    run.SetLabel(kTechnologies[run.range(0)]);
    run.SetItemsProcessed(run.iterations() * static_cast<std::int64_t>(stream.size()));
    run.SetBytesProcessed(run.iterations() * static_cast<std::int64_t>(stream.byteCount()));
}

void walk(benchmark::State& run)
{
    const bench::MessageStream& stream = streamOf(run.range(0));
    for ([[maybe_unused]] auto _ : run) {
        std::size_t codes = 0;
        for (std::span<const std::byte> rest = stream.bytes(); !rest.empty();) {
            codes += std::to_integer<std::size_t>(rest[3]) | std::to_integer<std::size_t>(rest[4]) << 8;
            rest = rest.subspan(
                1 + (std::to_integer<std::size_t>(rest[1]) | std::to_integer<std::size_t>(rest[2]) << 8));
        }
        benchmark::DoNotOptimize(codes);
    }
    count(run, stream);
}
BENCHMARK(walk)->DenseRange(0, 3);

void decode(benchmark::State& run)
{
    const bench::MessageStream& stream = streamOf(run.range(0));
    ScriptedPlatform platform;
    platform.useResourceDirectory(PELORUS_SOURCE_DIR "/resources");
    const auto generator = LogGenerator::generatorFromTechnology(platform, kTechnologies[run.range(0)]);
    State state;
    for ([[maybe_unused]] auto _ : run) {
        for (std::size_t index = 0; index < stream.size(); ++index)
            generator->updateState(state, stream[index]);
        generator->generateLogUsingState(state);
    }
    count(run, stream);
}
BENCHMARK(decode)->DenseRange(0, 3)->Unit(benchmark::kMillisecond);

} // namespace

BENCHMARK_MAIN();
