// An IFX message of 200 rows through its generator: a serving cell, and neighbours of ten rows each.

#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "platform/PropertyList.h"
#include "platform/scripted/ScriptedPlatform.h"

#include <benchmark/benchmark.h>
#include <fmt/format.h>

namespace {

using namespace pelorus;

std::shared_ptr<Dictionary> cell(int number)
{
    auto rows = makeDictionary({{"ARFCN", fmt::format("{}", 40 + number)}});
    for (const char* label : {"BSIC", "Cell ID", "LAC", "RxLev", "C1", "C2", "Band", "Timing"})
        rows->set(std::string_view(label), fmt::format("{}", number * 7));
    rows->set(Label("Level"), makeDictionary({{"dBm", fmt::format("-{} dBm", 60 + number)}}));
    return rows;
}

Bytes message(PropertyListForm form)
{
    auto neighbours = makeArray({"Neighbors"});
    for (int number = 1; number < 20; ++number)
        neighbours->elements.emplace_back(cell(number));
    return serializePropertyList(makeDictionary({{"Serving Cell", cell(0)}, {"Neighbors", neighbours}}), form)
        .value();
}

void update(benchmark::State& run)
{
    const auto form = run.range(0) == 0 ? PropertyListForm::xml : PropertyListForm::binary;
    const Bytes bytes = message(form);
    ScriptedPlatform platform;
    GSMLogGenerator generator(platform);
    State state;
    for ([[maybe_unused]] auto _ : run)
        generator.updateState(state, bytes);
    run.SetLabel(run.range(0) == 0 ? "XML" : "binary");
    run.SetItemsProcessed(run.iterations());
    run.SetBytesProcessed(run.iterations() * static_cast<std::int64_t>(bytes.size()));
}
BENCHMARK(update)->DenseRange(0, 1)->Unit(benchmark::kMicrosecond);

} // namespace

BENCHMARK_MAIN();
