// What a refresh costs the window: a pane of so many rows that gets a new node, up to the painted window.

#include "app/PelorusPaneController.h"

#include <QApplication>
#include <benchmark/benchmark.h>
#include <fmt/format.h>

namespace {

using namespace pelorus;

struct Host : PaneHost {
    bool allowSaveButton() const override { return true; }
    void showSaveView() override {}
};

std::shared_ptr<const PelorusModelNode> nodeWith(int rows, int turn)
{
    auto display = makeDictionary();
    for (int row = 0; row < rows; ++row)
        display->set(fmt::format("Neighbour {}", row), fmt::format("-{}.25 dBm", 60 + (row + turn) % 60));
    PathDictionary paths;
    return PelorusModelNode::makeTreeFromObject(display, paths);
}

/// Every value changes at every reload.
void reload(benchmark::State& run)
{
    const int rows = static_cast<int>(run.range(0));
    Host host;
    PelorusPaneController pane(nodeWith(rows, 0), "/", host);
    pane.resize(480, 760);
    pane.show();
    const std::shared_ptr<const PelorusModelNode> nodes[] = {nodeWith(rows, 1), nodeWith(rows, 2)};
    std::size_t turn = 0;
    for ([[maybe_unused]] auto _ : run) {
        pane.reloadWithNode(nodes[turn++ % 2]);
        QApplication::processEvents(); // which paints
    }
}
BENCHMARK(reload)->Arg(10)->Arg(1000)->Arg(10000)->Unit(benchmark::kMicrosecond);

} // namespace

int main(int argc, char** argv)
{
    qputenv("QT_QPA_PLATFORM", "offscreen");
    const QApplication application(argc, argv);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
