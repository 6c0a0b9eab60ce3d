#include "telephonyd/simulation/LtePackets.h"

#include "LogGenerator/Osprey/LTE/LogCode_0xB0C1.h"
#include "LogGenerator/Osprey/LTE/LogCode_0xB0C2.h"
#include "LogGenerator/Osprey/LTE/LogCode_0xB179.h"
#include "LogGenerator/Osprey/LTE/LogCode_0xB17F.h"
#include "LogGenerator/Osprey/LTE/LogCode_0xB180.h"
#include "telephonyd/simulation/LteCellChoice.h"

#include <algorithm>
#include <cmath>

namespace pelorus {

namespace {

constexpr int kVersion = 1;
constexpr int kQrxlevminSteps = 8; // of 2 dB above -140 dBm
static_assert(kQrxlevminSteps * 2 - 140 == static_cast<int>(kLteQrxlevmin));
constexpr int kMaximumPower = 23 + 30; // 23 dBm
constexpr int kSIntraSearch = 31;      // 62 dB: the own carrier is searched nearly always
constexpr int kSNonIntraSearch = 11;   // 22 dB
constexpr double kHighestReportedRsrq = -3.0;
constexpr std::uint32_t kSamplesPerFrame = 307200;
constexpr std::uint32_t kFrames = 1024;
constexpr double kSamplesPerMetre = 30.72e6 / 299792458.0;

double reported(double rsrq)
{
    return std::clamp(rsrq, kLowestReportedRsrq, kHighestReportedRsrq);
}

int srxlevField(const LteMeasurement& cell)
{
    return stepsAbove(-30, srxlev(cell), 1);
}

/// When the cell's frame begins, seen from the handset's own clock.
std::uint32_t sampleOffset(const LteRadio& radio, std::size_t cell)
{
    const auto travel = static_cast<std::uint32_t>(radio.distance(cell) * kSamplesPerMetre);
    return (kLteCells[cell].sampleOffset + travel) % kSamplesPerFrame;
}

void writeNeighbour(PacketWriter record, const LteRadio& radio, std::size_t serving, std::size_t cell)
{
    using Cell = LogCode_0xB180::Cell;
    const LteMeasurement& measured = radio[cell];
    record.put(Cell::physicalCellIdentity, kLteCells[cell].physicalCellIdentity);
    record.put(Cell::measuredRssi, stepsAbove(-140, radio.rssi(kLteCells[cell].carrier), 2));
    record.put(Cell::measuredRsrp, stepsAbove(-140, measured.rsrp, 2));
    record.put(Cell::averageRsrp, stepsAbove(-140, measured.averageRsrp, 2));
    record.put(Cell::measuredRsrq, stepsAbove(-30, reported(measured.rsrq), 4));
    record.put(Cell::averageRsrq, stepsAbove(-30, reported(measured.averageRsrq), 4));
    record.put(Cell::srxlev, srxlevField(measured));
    record.put(Cell::frameOffset,
               (kLteCells[cell].frameOffset + kFrames - kLteCells[serving].frameOffset) % kFrames);
    record.put(Cell::sampleOffset, sampleOffset(radio, cell));
}

} // namespace

int stepsAbove(double lowest, double level, double stepsPerUnit)
{
    return static_cast<int>(std::lround(std::max(0.0, (level - lowest) * stepsPerUnit)));
}

void writeServingCell(MessageBatch& log, std::size_t serving)
{
    const LteCell& cell = kLteCells[serving];
    const LteCarrier& carrier = kLteCarriers[cell.carrier];
    {
        using Layout = LogCode_0xB0C2;
        PacketWriter packet = log.packet(0xB0C2, Layout::minimumLength);
        packet.put(Layout::physicalCellIdentity, cell.physicalCellIdentity);
        packet.put(Layout::downlinkEarfcn, carrier.earfcn);
        packet.put(Layout::uplinkEarfcn, carrier.earfcn + kUplinkEarfcnOffset);
        packet.put(Layout::downlinkBandwidth, carrier.resourceBlocks);
        packet.put(Layout::uplinkBandwidth, carrier.resourceBlocks);
        packet.put(Layout::cellIdentity, cell.cellIdentity);
        packet.put(Layout::trackingAreaCode, cell.trackingAreaCode);
        packet.put(Layout::bandIndicator, carrier.band);
    }
    using Layout = LogCode_0xB0C1;
    PacketWriter packet = log.packet(0xB0C1, Layout::minimumLength);
    packet.put(Layout::physicalCellIdentity, cell.physicalCellIdentity);
    packet.put(Layout::earfcn, carrier.earfcn);
    packet.put(Layout::transmitAntennas, cell.antennas);
}

void writeServingMeasurement(MessageBatch& log, const LteRadio& radio, std::size_t serving,
                             const LteMeasurementRules& rules)
{
    using Layout = LogCode_0xB17F;
    const LteMeasurement& measured = radio[serving];
    const LteCarrier& carrier = kLteCarriers[kLteCells[serving].carrier];
    PacketWriter packet = log.packet(0xB17F, Layout::minimumLength);
    packet.put(Layout::version, kVersion);
    packet.put(Layout::earfcn, carrier.earfcn);
    packet.put(Layout::physicalCellIdentity, kLteCells[serving].physicalCellIdentity);
    packet.put(Layout::servingLayerPriority, carrier.priority);
    packet.put(Layout::measuredRsrp, stepsAbove(-140, measured.rsrp, 4));
    packet.put(Layout::averageRsrp, stepsAbove(-140, measured.averageRsrp, 4));
    packet.put(Layout::measuredRsrq, stepsAbove(-30, reported(measured.rsrq), 4));
    packet.put(Layout::averageRsrq, stepsAbove(-30, reported(measured.averageRsrq), 4));
    packet.put(Layout::measuredRssi, stepsAbove(-140, radio.rssi(kLteCells[serving].carrier), 2));
    packet.put(Layout::qrxlevmin, kQrxlevminSteps);
    packet.put(Layout::maximumPower, kMaximumPower);
    packet.put(Layout::maximumTransmitPower, kMaximumPower);
    packet.put(Layout::srxlev, srxlevField(measured));
    packet.put(Layout::weakDrxCycles, rules.weakCycles);
    packet.put(Layout::sIntraSearch, kSIntraSearch);
    packet.put(Layout::sNonIntraSearch, kSNonIntraSearch);
    packet.put(Layout::measurementRulesUpdated, rules.updated ? 1 : 0);
    packet.put(Layout::measurementRules, rules.rules);
}

void writeNeighbours(MessageBatch& log, const LteRadio& radio, std::size_t serving, std::size_t carrier,
                     const LteCellList& cells, double frequencyOffset)
{
    using Layout = LogCode_0xB180;
    PacketWriter packet = log.packet(0xB180, Layout::minimumLength + Layout::cells.stride * cells.size());
    packet.put(Layout::version, kVersion);
    packet.put(Layout::earfcn, kLteCarriers[carrier].earfcn);
    packet.put(Layout::qrxlevmin, kQrxlevminSteps);
    packet.put(Layout::cellsLessOne, static_cast<std::int64_t>(cells.size()) - 1);
    std::size_t index = 0;
    for (const std::size_t cell : cells) {
        PacketWriter record = packet.record(Layout::cells, index++);
        writeNeighbour(record, radio, serving, cell);
        record.put(Layout::Cell::frequencyOffset, stepsAbove(0, frequencyOffset, 1));
    }
}

void writeConnectedMeasurement(MessageBatch& log, const LteRadio& radio, std::size_t serving,
                               const LteCellList& measured, const LteCellList& detected, int subframe)
{
    using Layout = LogCode_0xB179;
    const Records detectedCells = Layout::detectedCells(measured.size());
    PacketWriter packet = log.packet(0xB179, detectedCells.start + detectedCells.stride * detected.size());
    packet.put(Layout::earfcn, kLteCarriers[kLteCells[serving].carrier].earfcn);
    packet.put(Layout::servingCellIdentity, kLteCells[serving].physicalCellIdentity);
    packet.put(Layout::subframeNumber, subframe);
    packet.put(Layout::servingRsrp, stepsAbove(-140, radio[serving].averageRsrp, 4));
    packet.put(Layout::servingRsrq, stepsAbove(-20, reported(radio[serving].averageRsrq), 8));
    packet.put(Layout::measuredCount, static_cast<std::int64_t>(measured.size()));
    packet.put(Layout::detectedCount, static_cast<std::int64_t>(detected.size()));
    std::size_t index = 0;
    for (const std::size_t cell : measured) {
        PacketWriter record = packet.record(Layout::measuredCells, index++);
        record.put(Layout::MeasuredCell::physicalCellIdentity, kLteCells[cell].physicalCellIdentity);
        record.put(Layout::MeasuredCell::rsrp, stepsAbove(-140, radio[cell].averageRsrp, 4));
        record.put(Layout::MeasuredCell::rsrq, stepsAbove(-20, reported(radio[cell].averageRsrq), 8));
    }
    index = 0;
    for (const std::size_t cell : detected)
        packet.record(detectedCells, index++)
            .put(Layout::DetectedCell::physicalCellIdentity, kLteCells[cell].physicalCellIdentity);
}

} // namespace pelorus
