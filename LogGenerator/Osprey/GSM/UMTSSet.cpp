#include "LogGenerator/Osprey/GSM/UMTSSet.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x4005.h"
#include "LogGenerator/Osprey/MonitoredCells.h"

namespace pelorus {

namespace {

using Layout = LogCode_0x4005;
using Cell = Layout::UMTSCell;
constexpr Row kCellRows[] = {
    number("Scrambling Code", "%d", Cell::scramblingCode),
    number("RSCP", "%d dB", Cell::rscp, {1, -21}),
    level("Energy Per Chip", "%f dB", Cell::ecno, 0.5, 0.0),
    number("Downlink Frequency", "%d", Cell::downlinkUarfcn),
    number("Ranking Value", "%d", Cell::rankingValue),
    number("Rank Cell RSCP", "%d dB", Cell::rankRscp),
};
constexpr CellRow kMonitorRows[] = {
    {CellMonitor::kUARFCN, "UARFCN", "UMTSSet: Failed to retrieve UARFCN\n"},
    {CellMonitor::kSCN, "Scrambling Code", "UMTSSet: Failed to retrieve Scrambling Code\n"},
    {CellMonitor::kRSCP, "RSCP", "UMTSSet: Failed to retrieve RSCP\n", "%d dBm", 1, true},
    {CellMonitor::kECN0, "Energy Per Chip", "UMTSSet: Failed to retrieve Energy Per Chip\n", "%d dB", 1,
     true},
};

void showCells(TableSection& section, const LogPacket& data)
{
    section.showList(data, Layout::umtsCells, static_cast<std::size_t>(data[Layout::umtsCellCount]),
                     kCellRows);
}

void showMonitoredCells(TableSection& section, const LogPacket& data)
{
    showNeighborCells(section, data, CellMonitor::kUMTS, kMonitorRows);
}

constexpr Reading kReadings[] = {
    {0x4005, Layout::minimumLength, {}, showCells, overtakesAlways},
    {kCellMonitorList, 0, {}, showMonitoredCells},
};
constexpr SectionDescription kDescription{"UMTS Set", "UMTSSet", kReadings};

} // namespace

UMTSSet::UMTSSet() : TableSection(kDescription) {}

} // namespace pelorus
