// What a list of the telephony server costs: the guard and libplist together, by kind.

#include "bench/MessageStream.h"
#include "platform/PropertyList.h"

#include <benchmark/benchmark.h>

namespace {

using namespace pelorus;

void parse(benchmark::State& run)
{
    const bench::MessageStream stream("Osprey LTE", 20'000);
    const auto code = static_cast<std::byte>(run.range(0));
    std::vector<std::span<const std::byte>> lists;
    for (std::size_t index = 0; index < stream.size(); ++index)
        if (const auto message = stream[index]; message[0] == std::byte{0xFF} && message[3] == code)
            lists.push_back(message.subspan(13));
    std::size_t next = 0;
    for ([[maybe_unused]] auto _ : run) {
        const Value list = parsePropertyList(lists[next]);
        benchmark::DoNotOptimize(static_cast<bool>(list));
        next = (next + 1) % lists.size();
    }
    run.SetLabel(run.range(0) == 0 ? "SIM files" : run.range(0) == 1 ? "cell list" : "PDP contexts");
}
BENCHMARK(parse)->DenseRange(0, 2)->Unit(benchmark::kMicrosecond);

} // namespace

BENCHMARK_MAIN();
