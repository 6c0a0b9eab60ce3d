#include "telephonyd/simulation/LteServerMessages.h"

#include "LogGenerator/Osprey/CellMonitorKeys.h"
#include "telephonyd/simulation/LteCellList.h"

namespace pelorus {

namespace {

constexpr double kForgottenBelow = 6.0; // dB under what makes a cell known

using namespace CellMonitor;
constexpr std::string_view kServingKeys[] = {kMCC, kMNC, kTAC, kCellId, kPID, kBandInfo, kUARFCN};
constexpr MonitoredCellKind kServingKind{kLTE, true, kServingKeys};
constexpr std::string_view kNeighbourKeys[] = {kPID, kBandInfo, kUARFCN}; // nothing that it broadcasts
constexpr MonitoredCellKind kNeighbourKind{kLTE, false, kNeighbourKeys};

} // namespace

void LteServerMessages::cellsAround(MessageBatch& log, const LteRadio& radio,
                                    const LteSurroundings& surroundings, std::size_t serving)
{
    cellList.clear();
    const LteCell& here = kLteCells[serving];
    const LteCarrier& carrier = kLteCarriers[here.carrier];
    cellList.add(kServingKind, {1, 1, here.trackingAreaCode, here.cellIdentity, here.physicalCellIdentity,
                                carrier.band, carrier.earfcn});
    for (std::size_t cell = 0; cell < kLteCellCount; ++cell) {
        // One that was known stays so for some fading.
        const bool before = (knownCells >> cell & 1) != 0;
        const bool known = radio[cell].averageRsrq > kLowestReportedRsrq - (before ? kForgottenBelow : 0.0);
        knownCells = (knownCells & ~(1U << cell)) | (known ? 1U << cell : 0U);
        const LteCarrier& carrierThere = kLteCarriers[kLteCells[cell].carrier];
        if (known && cell != serving)
            cellList.add(kNeighbourKind,
                         {kLteCells[cell].physicalCellIdentity, carrierThere.band, carrierThere.earfcn});
    }
    surroundings.appendTo(cellList);
    cellList.write(log);
}

void LteServerMessages::contexts(MessageBatch& log, bool inSession)
{
    subscriber.contexts(log, inSession);
}

void LteServerMessages::sim(MessageBatch& log, std::size_t serving)
{
    subscriber.sim(log, kLteCells[serving].trackingAreaCode);
}

} // namespace pelorus
