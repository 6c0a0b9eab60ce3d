#include "telephonyd/simulation/UmtsPackets.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x4005.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x4031.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x4127.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x417A.h"
#include "telephonyd/simulation/RankedCells.h"
#include "telephonyd/simulation/Units.h"

#include <algorithm>

namespace pelorus {

namespace {

constexpr std::size_t kMostMonitored = 4;
constexpr int kActiveSet = 0;
constexpr int kMonitoredSet = 1;
constexpr double kFullScale = 524288;      // of the linear Ec/Io
constexpr double kLowestEcio = -20.0;      // the pilot is lost below
constexpr double kRankingHysteresis = 4.0; // Qhyst1, dB

// 3GPP TS 25.331, 10.3.7.43: open loop, with interference and the service's needs in one.
constexpr double kPowerAtNoLevel = -95.0;
constexpr double kPowerSpread = 1.5;
constexpr double kLowestPower = -50.0;
constexpr double kHighestPower = 24.0;
constexpr std::size_t kPowerSamples = 4;

void writeSetMember(const PacketWriter& packet, Records measurements, std::size_t index, std::size_t cell,
                    int set, double ecio)
{
    using Layout = LogCode_0x417A;
    PacketWriter entry = packet.record(Layout::cells, index);
    entry.put(Layout::Cell::scramblingCode, kUmtsCells[cell].scramblingCode);
    entry.put(Layout::Cell::set, set);
    const double linear = kFullScale * std::exp2(std::max(ecio, kLowestEcio) * 0.33219281);
    packet.record(measurements, index).put(Layout::Measurement::ecio[0], std::lround(linear));
}

} // namespace

void writeUmtsCellSet(MessageBatch& log, const UmtsRadio& radio, const SoftHandover& activeSet)
{
    using Layout = LogCode_0x417A;
    RankedCells<kUmtsCellCount> monitored;
    for (std::size_t cell = 0; cell < kUmtsCellCount; ++cell)
        if (!activeSet.contains(cell) && radio.isDetected(cell))
            monitored.add(cell, radio[cell].averageEcio);
    monitored.limit(kMostMonitored);
    const std::size_t count = activeSet.size() + monitored.size();

    const Records measurements = Layout::measurements(count);
    PacketWriter packet = log.packet(0x417A, measurements.start + measurements.stride * count);
    packet.put(Layout::receivedPower, rounded((radio.rssi() + 106.0) * 10.0) - 512);
    packet.put(Layout::cellCount, static_cast<std::int64_t>(count));
    std::size_t index = 0;
    for (const std::size_t cell : activeSet)
        writeSetMember(packet, measurements, index++, cell, kActiveSet, radio[cell].averageEcio);
    for (const std::size_t cell : monitored)
        writeSetMember(packet, measurements, index++, cell, kMonitoredSet, radio[cell].averageEcio);
}

void writeRankedUmtsCells(MessageBatch& log, const UmtsRadio& radio, std::size_t serving)
{
    using Layout = LogCode_0x4005;
    using Cell = Layout::UMTSCell;
    const auto rank = [&radio, serving](std::size_t cell) {
        return radio[cell].averageRscp + (cell == serving ? kRankingHysteresis : 0.0);
    };
    RankedCells<kUmtsCellCount> cells;
    for (std::size_t cell = 0; cell < kUmtsCellCount; ++cell)
        if (cell == serving || radio.isDetected(cell))
            cells.add(cell, rank(cell));

    PacketWriter packet =
        log.packet(0x4005, Layout::umtsCells.start + Layout::umtsCells.stride * cells.size());
    packet.put(Layout::umtsCellCount, static_cast<std::int64_t>(cells.size()));
    std::size_t index = 0;
    for (const std::size_t cell : cells) {
        PacketWriter entry = packet.record(Layout::umtsCells, index++);
        const int rscp = rounded(radio[cell].averageRscp);
        entry.put(Cell::downlinkUarfcn, kUmtsUarfcn);
        entry.put(Cell::scramblingCode, kUmtsCells[cell].scramblingCode);
        entry.put(Cell::rscp, rscp + 21);
        entry.put(Cell::rankRscp, rscp);
        entry.put(Cell::ecno, rounded(std::max(radio[cell].averageEcio, kLowestEcio) * 2.0));
        entry.put(Cell::rankingValue, rounded(rank(cell)));
    }
}

void writeUmtsServingCell(MessageBatch& log, std::size_t serving)
{
    using Layout = LogCode_0x4127;
    const UmtsCell& cell = kUmtsCells[serving];
    PacketWriter packet = log.packet(0x4127, Layout::minimumLength);
    packet.put(Layout::uplinkUarfcn, kUmtsUplinkUarfcn);
    packet.put(Layout::downlinkUarfcn, kUmtsUarfcn);
    packet.put(Layout::cellIdentity, cell.cellIdentity);
    packet.put(Layout::registrationArea, cell.registrationArea);
}

void writeTransmitPower(MessageBatch& log, double rscp, Random& random)
{
    using Layout = LogCode_0x4031;
    PacketWriter packet = log.packet(0x4031, Layout::samples.start + Layout::samples.stride * kPowerSamples);
    packet.put(Layout::sampleCount, kPowerSamples);
    for (std::size_t index = 0; index < kPowerSamples; ++index) {
        const double power =
            std::clamp(kPowerAtNoLevel - rscp + kPowerSpread * random.normal(), kLowestPower, kHighestPower);
        const int raw = rounded((power + 70.0) * 10.0) - 512;
        packet.record(Layout::samples, index).put(Layout::Sample::power, raw == 0 ? 1 : raw);
    }
}

} // namespace pelorus
