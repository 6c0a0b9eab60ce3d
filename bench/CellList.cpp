// A list of six cells, as the telephony server sends it, through the sections that show it, beside what
// libplist alone takes to parse it.

#include "LogGenerator/LogGenerator.h"
#include "bench/MessageStream.h"
#include "bench/Paired.h"
#include "platform/PropertyList.h"
#include "platform/scripted/ScriptedPlatform.h"

#include <plist/plist.h>
#include <stdexcept>

namespace {

using namespace pelorus;

constexpr std::size_t kCells = 6;
constexpr std::size_t kHeaderLength = 13;
constexpr std::size_t kRepetitions = 2'000; // of the list in a round

/// The first cells of the first longer list of a simulated handset: its own cell, then those around.
std::vector<std::byte> messageOfCells()
{
    const bench::MessageStream stream("Osprey LTE", 20'000);
    for (std::size_t index = 0; index < stream.size(); ++index) {
        const auto message = stream[index];
        if (message[0] != std::byte{0xFF} || message[3] != std::byte{1})
            continue;
        const Value list = parsePropertyList(message.subspan(kHeaderLength));
        if (!list.array() || list.array()->elements.size() < kCells)
            continue;
        list.array()->elements.resize(kCells);
        const auto bytes = serializePropertyList(list, PropertyListForm::binary).value();
        std::vector<std::byte> shorter(message.begin(), message.begin() + kHeaderLength);
        shorter.insert(shorter.end(), bytes.begin(), bytes.end());
        shorter[1] = static_cast<std::byte>(shorter.size() - 1);
        shorter[2] = static_cast<std::byte>((shorter.size() - 1) >> 8);
        return shorter;
    }
    throw std::runtime_error("the simulated handset never saw so many cells");
}

void rowsBesideParse(benchmark::State& run)
{
    const std::vector<std::byte> message = messageOfCells();
    const auto list = std::span(message).subspan(kHeaderLength);
    ScriptedPlatform platform;
    platform.useResourceDirectory(PELORUS_SOURCE_DIR "/resources");
    const auto generator = LogGenerator::generatorFromTechnology(platform, "Osprey LTE");
    State state;
    const auto ours = [&] {
        for (std::size_t turn = 0; turn < kRepetitions; ++turn)
            generator->updateState(state, message);
        generator->generateLogUsingState(state); // so that the raw messages do not pile up
    };
    const auto theirs = [&] {
        for (std::size_t turn = 0; turn < kRepetitions; ++turn) {
            plist_t root = nullptr;
            plist_from_bin(reinterpret_cast<const char*>(list.data()),
                           static_cast<std::uint32_t>(list.size()), &root);
            benchmark::DoNotOptimize(root);
            plist_free(root);
        }
    };
    bench::compare(run, bench::processorSeconds, kRepetitions, ours, theirs);
    run.counters["bytes"] = static_cast<double>(list.size());
}
BENCHMARK(rowsBesideParse)->UseManualTime()->Iterations(25)->Unit(benchmark::kMillisecond);

} // namespace

BENCHMARK_MAIN();
