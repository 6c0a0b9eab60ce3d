#include "telephonyd/simulation/GsmCellMonitor.h"

#include "LogGenerator/Osprey/CellMonitorKeys.h"

#include <cmath>

namespace pelorus {

namespace {

using namespace CellMonitor;

constexpr std::string_view kUmtsServingKeys[] = {kMCC, kMNC, kLAC, kCellId, kBandInfo, kUARFCN, kSCN};
constexpr MonitoredCellKind kUmtsServing{kUMTS, true, kUmtsServingKeys};
constexpr std::string_view kUmtsNeighbourKeys[] = {kUARFCN, kSCN, kRSCP, kECN0};
constexpr MonitoredCellKind kUmtsNeighbour{kUMTS, false, kUmtsNeighbourKeys};
constexpr std::string_view kGsmServingKeys[] = {kMCC, kMNC, kLAC, kCellId, kBandInfo, kARFCN};
constexpr MonitoredCellKind kGsmServing{kGSM, true, kGsmServingKeys};
constexpr std::string_view kGsmNeighbourKeys[] = {kARFCN, kRSSI};
constexpr MonitoredCellKind kGsmNeighbour{kGSM, false, kGsmNeighbourKeys};

constexpr std::size_t kMostGsmNeighbours = 6;
/// Share of the neighbours that are known but were not measured of late.
constexpr double kUnmeasured = 0.05;
constexpr double kUnmeasuredElsewhere = 0.3; // of the other technology

} // namespace

void GsmCellMonitor::writeInUmts(MessageBatch& log, const UmtsRadio& umts, std::size_t serving,
                                 const GsmRadio& gsm, Random& random)
{
    const UmtsCell& cell = kUmtsCells[serving];
    list.clear();
    list.add(kUmtsServing,
             {1, 1, cell.locationArea, cell.cellIdentity, kUmtsBand, kUmtsUarfcn, cell.scramblingCode});
    addUmtsNeighbours(umts, serving, kUnmeasured, random);
    addGsmNeighbours(gsm, kNoGsmCell, kUnmeasuredElsewhere, random);
    list.write(log);
}

void GsmCellMonitor::writeInGsm(MessageBatch& log, const GsmRadio& gsm, std::size_t serving,
                                const UmtsRadio& umts, Random& random)
{
    const GsmCell& cell = kGsmCells[serving];
    list.clear();
    list.add(kGsmServing, {1, 1, cell.locationArea, cell.cellIdentity, kGsmBand, cell.arfcn});
    addGsmNeighbours(gsm, serving, kUnmeasured, random);
    addUmtsNeighbours(umts, kUmtsCellCount, kUnmeasuredElsewhere, random);
    list.write(log);
}

void GsmCellMonitor::addUmtsNeighbours(const UmtsRadio& radio, std::size_t serving, double unmeasured,
                                       Random& random)
{
    for (std::size_t cell = 0; cell < kUmtsCellCount; ++cell) {
        if (cell == serving || !radio.isDetected(cell))
            continue;
        const bool isMissing = random.chance(unmeasured);
        list.add(kUmtsNeighbour, {kUmtsUarfcn, kUmtsCells[cell].scramblingCode,
                                  isMissing ? kUnavailable : std::lround(radio[cell].averageRscp),
                                  isMissing ? kUnavailable : std::lround(radio[cell].averageEcio)});
    }
}

void GsmCellMonitor::addGsmNeighbours(const GsmRadio& radio, std::size_t serving, double unmeasured,
                                      Random& random)
{
    for (const std::size_t cell : radio.neighbours(serving, kMostGsmNeighbours))
        list.add(kGsmNeighbour,
                 {kGsmCells[cell].arfcn,
                  random.chance(unmeasured) ? kUnavailable : std::lround(radio.average(cell) / 2)});
}

} // namespace pelorus
