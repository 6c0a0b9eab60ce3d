#include "telephonyd/simulation/GsmPackets.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x4005.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x5072.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x5076.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x5137.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51F8.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51FF.h"
#include "telephonyd/simulation/Units.h"

namespace pelorus {

namespace {

constexpr double kLowestAccessLevel = -104.0; // RXLEV_ACCESS_MIN

/// RXLEV (3GPP TS 45.008, 8.1.4), 0 to 63.
int receiveLevel(double level)
{
    return rounded(level + 110.0);
}

PacketWriter beginMeasurement(MessageBatch& log, const GsmRadio& radio, std::size_t serving,
                              const RankedGsmCells& neighbours)
{
    using Layout = LogCode_0x5137;
    PacketWriter packet =
        log.packet(0x5137, Layout::neighbours.start + Layout::neighbours.stride * neighbours.size());
    packet.put(Layout::receiveLevel, receiveLevel(radio.level(serving)));
    packet.put(Layout::neighbourCount, static_cast<std::int64_t>(neighbours.size()));
    std::size_t index = 0;
    for (const std::size_t cell : neighbours) {
        PacketWriter entry = packet.record(Layout::neighbours, index++);
        entry.put(Layout::Neighbour::arfcn, kGsmCells[cell].arfcn);
        entry.put(Layout::Neighbour::receiveLevel, receiveLevel(radio.average(cell)));
        entry.put(Layout::Neighbour::c1, rounded(pathLossCriterion(radio, cell)));
    }
    return packet;
}

} // namespace

double pathLossCriterion(const GsmRadio& radio, std::size_t cell)
{
    return radio.average(cell) - kLowestAccessLevel;
}

double reselectionCriterion(const GsmRadio& radio, std::size_t cell)
{
    return pathLossCriterion(radio, cell) + kGsmCells[cell].reselectOffset;
}

void writeGsmIdleMeasurement(MessageBatch& log, const GsmRadio& radio, std::size_t serving,
                             const RankedGsmCells& neighbours)
{
    using Layout = LogCode_0x5137;
    PacketWriter packet = beginMeasurement(log, radio, serving, neighbours);
    packet.put(Layout::c1, rounded(pathLossCriterion(radio, serving)));
    packet.put(Layout::c2, rounded(reselectionCriterion(radio, serving)));
    // The hysteresis counts towards cells of other areas only.
    const bool isAreaBorder =
        !neighbours.empty() && kGsmCells[neighbours.front()].locationArea != kGsmCells[serving].locationArea;
    packet.put(Layout::reselectHysteresis, isAreaBorder ? 1 : 0);
}

void writeGsmDedicatedMeasurement(MessageBatch& log, const GsmRadio& radio, std::size_t serving,
                                  GsmQuality quality, const RankedGsmCells& neighbours)
{
    using Layout = LogCode_0x5137;
    PacketWriter packet = beginMeasurement(log, radio, serving, neighbours);
    packet.put(Layout::receiveQualityFull, quality.full);
    packet.put(Layout::receiveQualitySub, quality.sub);
}

void writeStationIdentities(MessageBatch& log, const RankedGsmCells& neighbours)
{
    using Layout = LogCode_0x51FF;
    PacketWriter packet =
        log.packet(0x51FF, Layout::entries.start + Layout::entries.stride * neighbours.size());
    packet.put(Layout::entryCount, static_cast<std::int64_t>(neighbours.size()));
    std::size_t index = 0;
    for (const std::size_t cell : neighbours) {
        PacketWriter entry = packet.record(Layout::entries, index++);
        entry.put(Layout::Entry::arfcn, kGsmCells[cell].arfcn);
        entry.put(Layout::Entry::bsic, kGsmCells[cell].colourCode);
    }
}

void writeRankedGsmCells(MessageBatch& log, const GsmRadio& radio, const RankedGsmCells& cells)
{
    using Layout = LogCode_0x4005;
    using Cell = Layout::GSMCell;
    PacketWriter packet = log.packet(0x4005, Layout::gsmCells.start + Layout::gsmCells.stride * cells.size());
    packet.put(Layout::gsmCellCount, static_cast<std::int64_t>(cells.size()));
    std::size_t index = 0;
    for (const std::size_t cell : cells) {
        PacketWriter entry = packet.record(Layout::gsmCells, index++);
        entry.put(Cell::arfcn, kGsmCells[cell].arfcn);
        entry.put(Cell::bsic, kGsmCells[cell].colourCode);
        entry.put(Cell::rssi, rounded(radio.average(cell)));
        entry.put(Cell::rankingValue, rounded(radio.average(cell)));
    }
}

void writeDedicatedChannel(MessageBatch& log, std::uint16_t arfcn)
{
    using Layout = LogCode_0x5076;
    log.packet(0x5076, Layout::minimumLength).put(Layout::dedicatedArfcn, arfcn);
}

void writeHopping(MessageBatch& log, std::size_t serving)
{
    using Layout = LogCode_0x51F8;
    const GsmCell& cell = kGsmCells[serving];
    const std::size_t count = cell.hoppingChannels.size();
    PacketWriter packet = log.packet(0x51F8, Layout::channels.start + Layout::channels.stride * count);
    packet.put(Layout::hoppingSequence, cell.hoppingSequence);
    packet.put(Layout::channelCount, static_cast<std::int64_t>(count));
    for (std::size_t index = 0; index < count; ++index)
        packet.record(Layout::channels, index).put(Layout::Channel::arfcn, cell.hoppingChannels[index]);
}

void writeDiscontinuousTransmission(MessageBatch& log, bool isUsed)
{
    using Layout = LogCode_0x5072;
    log.packet(0x5072, Layout::minimumLength).put(Layout::discontinuousTransmission, isUsed ? 1 : 0);
}

} // namespace pelorus
