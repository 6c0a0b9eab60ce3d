#include "LogGenerator/Osprey/GSM/NeighboringCells.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x5137.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51FF.h"
#include "LogGenerator/Osprey/MonitoredCells.h"

namespace pelorus {

namespace {

using Measurement = LogCode_0x5137;
using Neighbour = Measurement::Neighbour;
constexpr Row kNeighbourRows[] = {
    number("ARFCN", "%d", Neighbour::arfcn),
    number("RSSI", "%d", Neighbour::receiveLevel),
    number("C1 Value", "%d", Neighbour::c1),
};
constexpr Format kBsic = "%d";
constexpr CellRow kMonitorRows[] = {
    {CellMonitor::kARFCN, "ARFCN", "NeighboringCells: Failed to retrieve ARFCN\n"},
    {CellMonitor::kRSSI, "RSSI", "NeighboringCells: Failed to retrieve RSSI\n", "%d dBm", 2, true},
};

ArfcnToBsic& identities(TableSection& section)
{
    return static_cast<NeighboringCells&>(section).arfcnToBsic;
}

void showNeighbours(TableSection& section, const LogPacket& data)
{
    const std::size_t count = data.wholeRecords(Measurement::neighbours,
                                                static_cast<std::size_t>(data[Measurement::neighbourCount]));
    section.buildList(count, [&](std::size_t index, RowWriter& rows) {
        const PacketView neighbour = data.record(Measurement::neighbours, index, count);
        rows.show(kNeighbourRows, neighbour);
        if (const auto bsic =
                identities(section).find(static_cast<std::uint16_t>(neighbour[Neighbour::arfcn])))
            kBsic.write(rows.next("BSIC").text(), *bsic);
        return true;
    });
}

void keepIdentities(TableSection& section, const LogPacket& data)
{
    using Layout = LogCode_0x51FF;
    const std::size_t count =
        data.wholeRecords(Layout::entries, static_cast<std::size_t>(data[Layout::entryCount]));
    identities(section).clear();
    for (std::size_t index = 0; index < count; ++index) {
        const PacketView entry = data.record(Layout::entries, index, count);
        identities(section).set(static_cast<std::uint16_t>(entry[Layout::Entry::arfcn]),
                                static_cast<std::uint8_t>(entry[Layout::Entry::bsic]));
    }
}

void showMonitoredCells(TableSection& section, const LogPacket& data)
{
    showNeighborCells(section, data, CellMonitor::kGSM, kMonitorRows);
}

constexpr Reading kReadings[] = {
    {0x5137, Measurement::minimumLength, {}, showNeighbours, overtakesAlways},
    {0x51FF, LogCode_0x51FF::minimumLength, {}, keepIdentities},
    {kCellMonitorList, 0, {}, showMonitoredCells},
};
constexpr SectionDescription kDescription{"Neighboring Cells", "NeighboringCells", kReadings};

} // namespace

NeighboringCells::NeighboringCells() : TableSection(kDescription) {}

} // namespace pelorus
