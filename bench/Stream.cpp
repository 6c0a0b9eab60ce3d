// The mixed stream of a handset through its generator and sections, the system log off, beside what merely
// walking the framed messages takes.

#include "LogGenerator/LogGenerator.h"
#include "bench/Dispatch.h"
#include "bench/Paired.h"
#include "platform/scripted/ScriptedPlatform.h"

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

/// The messages of a stream, through a generator of their technology.
class Decoder {
public:
    Decoder(const bench::MessageStream& messages, const char* technology) : stream(messages)
    {
        platform.useResourceDirectory(PELORUS_SOURCE_DIR "/resources");
        generator = LogGenerator::generatorFromTechnology(platform, technology);
    }

    void decode()
    {
        for (std::size_t index = 0; index < stream.size(); ++index)
            generator->updateState(state, stream[index]);
        generator->generateLogUsingState(state);
    }

private:
    const bench::MessageStream& stream;
    ScriptedPlatform platform;
    std::unique_ptr<LogGenerator> generator;
    State state;
};

void walk(benchmark::State& run)
{
    const bench::MessageStream& stream = streamOf(run.range(0));
    const bench::Dispatch dispatch(stream);
    for ([[maybe_unused]] auto _ : run)
        benchmark::DoNotOptimize(dispatch.walk(stream.bytes()));
    count(run, stream);
}
BENCHMARK(walk)->DenseRange(0, 3);

void decode(benchmark::State& run)
{
    const bench::MessageStream& stream = streamOf(run.range(0));
    Decoder decoder(stream, kTechnologies[run.range(0)]);
    for ([[maybe_unused]] auto _ : run)
        decoder.decode();
    count(run, stream);
}
BENCHMARK(decode)->DenseRange(0, 3)->Unit(benchmark::kMillisecond);

void decodeBesideWalk(benchmark::State& run)
{
    const bench::MessageStream& stream = streamOf(run.range(0));
    const bench::Dispatch dispatch(stream);
    Decoder decoder(stream, kTechnologies[run.range(0)]);
    bench::compare(
        run, bench::processorSeconds, stream.size(), [&] { decoder.decode(); },
        [&] { benchmark::DoNotOptimize(dispatch.walk(stream.bytes())); });
    run.SetLabel(kTechnologies[run.range(0)]);
}
BENCHMARK(decodeBesideWalk)->DenseRange(0, 3)->UseManualTime()->Iterations(25)->Unit(benchmark::kMillisecond);

} // namespace

BENCHMARK_MAIN();
