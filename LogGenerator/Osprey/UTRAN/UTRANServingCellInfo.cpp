#include "LogGenerator/Osprey/UTRAN/UTRANServingCellInfo.h"

#include "LogGenerator/Osprey/CellMonitor.h"
#include "LogGenerator/Osprey/UTRAN/LogCode_0xD0E2.h"

namespace pelorus {

namespace {

constexpr std::string_view kAccess[] = {"All Calls", "Emergency Calls Only"};

using Layout = LogCode_0xD0E2;
constexpr Row kRows[] = {
    number("Cell Access Restrictions", "%d", Layout::accessRestrictions),
    number("Cell ID", "%d", Layout::cellIdentity),
    number("Downlink UARFCN", "%d", Layout::downlinkUarfcn),
    number("Uplink UARFCN", "%d", Layout::uplinkUarfcn),
    number("URA ID", "%d", Layout::uraIdentity),
    text("Allowed Access", Layout::emergencyCallsOnly, kAccess, {}),
};

// The monitor tells one frequency, which is shown for both directions; its absence is logged once.
constexpr CellRow kMonitorRows[] = {
    {CellMonitor::kLAC, "Local Area Code", "Serving Cell Info: Failed to retrieve LAC\n"},
    {CellMonitor::kCellId, "Cell ID", "Serving Cell Info: Failed to retrieve Cell ID\n"},
    {CellMonitor::kBandInfo, "Freq Band Indicator",
     "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
    {CellMonitor::kSCN, "Cell Scrambling Code",
     "Serving Cell Info: Failed to retrieve Cell Scrambling Code\n"},
    {CellMonitor::kUARFCN, "Uplink UARFCN", "Serving Cell Info: Failed to retrieve UARFCN\n"},
    {CellMonitor::kUARFCN, "Downlink UARFCN", {}},
};

void showMonitoredCells(TableSection& section, const LogPacket& data)
{
    const Array* cells = cellMonitorList(data);
    if (!cells)
        return;
    // The last serving cell of the list wins.
    for (const Value& cell : cells->elements)
        if (isCell(cell, {CellMonitor::kUTRAN2}, CellMonitor::kServing))
            showCellRows(*section.entry(), kMonitorRows, *cell.dictionary());
}

constexpr Reading kReadings[] = {
    {0xD0E2, Layout::minimumLength, kRows},
    {kCellMonitorList, 0, {}, showMonitoredCells},
};
constexpr SectionDescription kDescription{"Serving Cell Info", "Serving Cell Info", kReadings,
                                          UnknownCode::ignored};

} // namespace

UTRANServingCellInfo::UTRANServingCellInfo() : TableSection(kDescription) {}

} // namespace pelorus
