#include "telephonyd/simulation/LteServerMessages.h"

#include "LogGenerator/Osprey/CellMonitorKeys.h"
#include "telephonyd/simulation/LteCellList.h"
#include "telephonyd/simulation/PacketList.h"
#include "telephonyd/simulation/PdpContexts.h"
#include "telephonyd/simulation/SimFiles.h"

namespace pelorus {

namespace {

constexpr std::uint32_t kSimFiles = 0xFF0000;
constexpr std::uint32_t kContexts = 0xFF0002;

constexpr double kForgottenBelow = 6.0; // dB under what makes a cell known

using namespace CellMonitor;
constexpr std::string_view kServingKeys[] = {kMCC, kMNC, kTAC, kCellId, kPID, kBandInfo, kUARFCN};
constexpr MonitoredCellKind kServingKind{kLTE, true, kServingKeys};
constexpr std::string_view kNeighbourKeys[] = {kPID, kBandInfo, kUARFCN}; // nothing that it broadcasts
constexpr MonitoredCellKind kNeighbourKind{kLTE, false, kNeighbourKeys};

} // namespace

LteServerMessages::LteServerMessages(Random& random)
    : tmsi(0x20000000U + random.below(0x10000000U)), idleContexts(packetList(pdpContexts(false))),
      sessionContexts(packetList(pdpContexts(true)))
{}

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
    log.list(kContexts, inSession ? sessionContexts : idleContexts);
}

void LteServerMessages::sim(MessageBatch& log, std::size_t serving)
{
    log.list(kSimFiles, packetList(simFiles(kLteCells[serving].trackingAreaCode, tmsi)));
}

} // namespace pelorus
