#include "telephonyd/simulation/LteSurroundings.h"

#include "LogGenerator/Osprey/CellMonitorKeys.h"

#include <algorithm>
#include <cmath>

namespace pelorus {

namespace {

using Technology = ReselectionCandidate::Technology;

struct Cell {
    Technology technology;
    Point mast;
    std::uint16_t channel;
    std::uint16_t identity; // scrambling code or BSIC
    std::uint8_t band;
    std::uint16_t priority;
    std::uint32_t cellIdentity;
};

constexpr std::uint16_t kLocationAreaCode = 4301;

constexpr std::array<Cell, LteSurroundings::kCells> kTable = {{
    {Technology::utran, {0, 0}, 10638, 121, 1, 3, 0x2A1C4E1},
    {Technology::utran, {980, 150}, 10638, 305, 1, 3, 0x2A1C5A2},
    {Technology::utran, {430, 900}, 10663, 77, 1, 2, 0x2A1D013},
    {Technology::geran, {0, 0}, 62, 18, 0, 1, 20481},
    {Technology::geran, {980, 150}, 600, 1, 1, 1, 20533},
    {Technology::geran, {430, 900}, 104, 43, 0, 1, 20617},
}};

/// A foreign network next to the DCS 1800 cell, whose description shares the bytes of that cell's.
constexpr ReselectionCandidate kCdma = {
    .technology = Technology::cdma1x, .priority = 2, .channel = 600, .identity = 0x0101, .band = 1};

constexpr double kStrongest = -42.0; // dBm; below a mast the antenna looks over the road
constexpr int kWeakestUtran = -112;  // dBm; weaker ones are not found
constexpr int kWeakestGeran = -104;
constexpr int kWeakestMeasured = -100; // weaker ones are found, but not measured

using namespace CellMonitor;
constexpr std::string_view kUtranKeys[] = {kMCC,    kMNC, kLAC,  kCellId, kBandInfo,
                                           kUARFCN, kSCN, kRSCP, kECN0,   kRSSI};
constexpr MonitoredCellKind kUtranKind{kUMTS, false, kUtranKeys};
constexpr std::string_view kGeranKeys[] = {kMCC, kMNC, kLAC, kCellId, kBandInfo, kARFCN, kRSSI};
constexpr MonitoredCellKind kGeranKind{kGSM, false, kGeranKeys};

/// Ec/N0 in dB of a cell received at that level among a few others.
int energyRatio(int level)
{
    return std::clamp(-4 + (level + 70) / 4, -20, -4);
}

double levelAt(Point where, const Cell& cell, Random& random)
{
    const double east = where.x - cell.mast.x;
    const double north = where.y - cell.mast.y;
    const double metres = std::max(std::sqrt(east * east + north * north), 35.0);
    const double nearby = cell.technology == Technology::utran ? -58.0 : -50.0; // at 100 m
    return std::min(nearby - 36.0 * std::log10(metres / 100.0) + 5.0 * random.normal(), kStrongest);
}

} // namespace

void LteSurroundings::search(Point where, Random& random)
{
    found.clear();
    for (std::size_t i = 0; i < kCells; ++i) {
        const Cell& cell = kTable[i];
        levels[i] = static_cast<int>(std::lround(levelAt(where, cell, random)));
        const bool isUtran = cell.technology == Technology::utran;
        if (levels[i] < (isUtran ? kWeakestUtran : kWeakestGeran)) {
            levels[i] = kUnavailable;
            continue;
        }
        if (cell.channel == kCdma.channel)
            found.push_back(kCdma);
        found.push_back({cell.technology, cell.priority, cell.channel, cell.identity, cell.band});
    }
}

void LteSurroundings::appendTo(CellMonitorList& list) const
{
    for (std::size_t i = 0; i < kCells; ++i) {
        const Cell& cell = kTable[i];
        const int level = levels[i];
        if (level == kUnavailable)
            continue;
        if (cell.technology == Technology::utran)
            list.add(kUtranKind, {1, 1, kLocationAreaCode, cell.cellIdentity, cell.band, cell.channel,
                                  cell.identity, level, energyRatio(level), kUnavailable});
        else
            list.add(kGeranKind, {1, 1, kLocationAreaCode, cell.cellIdentity, cell.band, cell.channel,
                                  level < kWeakestMeasured ? kUnavailable : level / 2});
    }
}

} // namespace pelorus
