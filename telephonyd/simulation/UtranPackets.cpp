#include "telephonyd/simulation/UtranPackets.h"

#include "LogGenerator/Osprey/UTRAN/LogCode_0xD00A.h"
#include "LogGenerator/Osprey/UTRAN/LogCode_0xD00C.h"
#include "LogGenerator/Osprey/UTRAN/LogCode_0xD00E.h"
#include "LogGenerator/Osprey/UTRAN/LogCode_0xD0E0.h"
#include "LogGenerator/Osprey/UTRAN/LogCode_0xD0E2.h"
#include "telephonyd/simulation/Units.h"

namespace pelorus {

namespace {

constexpr std::size_t kMostNeighbours = 8;
constexpr std::size_t kMostGsmNeighbours = 6;
constexpr int kActiveSet = 0;
constexpr int kMonitoredSet = 1;
constexpr int kDetectedSet = 2;
constexpr double kMonitoredFrom = -102.0; // dBm; weaker ones the network did not name

/// BLER_LOG (3GPP TS 25.123, 9.1.1.6): 0 is no error, then steps of 0.065 from 10^-4.03.
int errorRateStep(double rate)
{
    return std::clamp(static_cast<int>((std::log10(rate) + 4.03) / 0.065) + 1, 0, 63);
}

/// UTRA_SIR (3GPP TS 25.123, 9.1.1.4): steps of half a dB from -11 dB.
int ratioStep(double ratio)
{
    return std::clamp(rounded((ratio + 11.0) * 2.0), 0, 63);
}

} // namespace

void writeUtranMode(MessageBatch& log, UtranMode mode)
{
    using Layout = LogCode_0xD0E0;
    PacketWriter packet = log.packet(0xD0E0, Layout::expectedLength);
    packet.put(Layout::version, Layout::knownVersion);
    packet.put(Layout::mode, static_cast<std::int64_t>(mode));
}

void writeUtranServingCell(MessageBatch& log, std::size_t serving)
{
    using Layout = LogCode_0xD0E2;
    const UtranCell& cell = kUtranCells[serving];
    PacketWriter packet = log.packet(0xD0E2, Layout::minimumLength);
    packet.put(Layout::uraIdentity, cell.registrationArea);
    packet.put(Layout::uplinkUarfcn, cell.uarfcn);
    packet.put(Layout::downlinkUarfcn, cell.uarfcn);
    packet.put(Layout::cellIdentity, cell.cellIdentity);
}

void writeUtranNeighbours(MessageBatch& log, const UtranRadio& radio, std::size_t serving, bool isConnected)
{
    using Layout = LogCode_0xD00A;
    using Cell = Layout::Cell;
    RankedCells<kUtranCellCount> cells;
    for (std::size_t cell = 0; cell < kUtranCellCount; ++cell)
        if (cell == serving ? isConnected : radio.isDetected(cell))
            cells.add(cell, radio.rscp(cell));
    cells.limit(kMostNeighbours);

    PacketWriter packet = log.packet(0xD00A, Layout::cells.start + Layout::cells.stride * cells.size());
    packet.put(Layout::cellCount, static_cast<std::int64_t>(cells.size()));
    std::size_t index = 0;
    for (const std::size_t cell : cells) {
        const bool isMonitored = radio.rscp(cell) >= kMonitoredFrom;
        PacketWriter entry = packet.record(Layout::cells, index++);
        entry.put(Cell::uarfcn, kUtranCells[cell].uarfcn);
        entry.put(Cell::cellIdentity, kUtranCells[cell].parameterIdentity);
        // P-CCPCH_RSCP_LEV (3GPP TS 25.123, 9.1.1.1): whole dB above -116 dBm.
        entry.put(Cell::filteredRscp, rounded(radio.rscp(cell) + 116.0));
        entry.put(Cell::setMembership, cell == serving ? kActiveSet
                                       : isMonitored   ? kMonitoredSet
                                                       : kDetectedSet);
        entry.put(Cell::inJdcsList, isMonitored ? 1 : 0);
    }
}

void writeUtranGsmNeighbours(MessageBatch& log, const GsmRadio& radio)
{
    using Layout = LogCode_0xD00E;
    using Cell = Layout::Cell;
    const RankedGsmCells cells = radio.neighbours(kNoGsmCell, kMostGsmNeighbours);
    PacketWriter packet = log.packet(0xD00E, Layout::cells.start + Layout::cells.stride * cells.size());
    packet.put(Layout::cellCount, static_cast<std::int64_t>(cells.size()));
    std::size_t index = 0;
    for (const std::size_t cell : cells) {
        PacketWriter entry = packet.record(Layout::cells, index++);
        // Its place in the neighbour list: a whole GSM cell identity has 16 bits.
        entry.put(Cell::cellIdentity, static_cast<std::int64_t>(cell));
        entry.put(Cell::bandIndicator, kGsmBand);
        entry.put(Cell::bsicValid, 1);
        entry.put(Cell::networkColourCode, kGsmCells[cell].colourCode >> 3);
        entry.put(Cell::stationColourCode, kGsmCells[cell].colourCode & 7);
        entry.put(Cell::arfcn, kGsmCells[cell].arfcn);
        entry.put(Cell::rssi, rounded(radio.average(cell)));
    }
}

void writeTransportChannels(MessageBatch& log, const UtranTraffic& traffic)
{
    using Layout = LogCode_0xD00C;
    using Composite = Layout::CompositeChannel;
    const auto channels = traffic.transportChannels();
    const auto composites = traffic.compositeChannels();
    const Records compositeRecords = Layout::compositeChannels(channels.size());
    PacketWriter packet =
        log.packet(0xD00C, compositeRecords.start + compositeRecords.stride * composites.size());
    packet.put(Layout::transportChannelCount, static_cast<std::int64_t>(channels.size()));
    packet.put(Layout::compositeChannelCount, static_cast<std::int64_t>(composites.size()));
    std::size_t index = 0;
    for (const UtranTraffic::TransportChannel& channel : channels) {
        PacketWriter entry = packet.record(Layout::transportChannels, index++);
        entry.put(Layout::TransportChannel::identity, channel.identity);
        entry.put(Layout::TransportChannel::blockErrorRate, errorRateStep(channel.errorRate));
    }
    index = 0;
    for (const UtranTraffic::CompositeChannel& channel : composites) {
        PacketWriter entry = packet.record(compositeRecords, index++);
        entry.put(Composite::identity, channel.identity);
        entry.put(Composite::timeslot, channel.timeslot);
        for (std::size_t position = 0; position < UtranTraffic::kPositions; ++position)
            entry.record(Composite::sirValues, position)
                .put(Composite::sir, ratioStep(channel.ratios[position]));
    }
}

} // namespace pelorus
