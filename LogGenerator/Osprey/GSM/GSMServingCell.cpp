#include "LogGenerator/Osprey/GSM/GSMServingCell.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x5076.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x5134.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x5137.h"
#include "LogGenerator/Osprey/MonitoredCells.h"

namespace pelorus {

namespace {

using Cell = LogCode_0x5134;
constexpr Row kCellRows[] = {
    number("Cell ID", "%d", Cell::cellIdentity),
    number("ARFCN", "%d", Cell::arfcn),
    number("BSIC", "%d", Cell::bsic),
};
using Measurement = LogCode_0x5137;
constexpr Row kMeasurementRows[] = {
    number("RSSI", "%d dBm", Measurement::receiveLevel), // the raw level, with no sign change: meant
    number("C1 Value", "%d", Measurement::c1),
    number("C2 Value", "%d", Measurement::c2),
};
constexpr Row kDedicatedRows[] = {number("MA Dedicated ARFCN", "%d", LogCode_0x5076::dedicatedArfcnLow)};
constexpr CellRow kMonitorRows[] = {
    {CellMonitor::kCellId, "Cell ID", "GSMServingCell: Failed to retrieve Cell ID\n"},
    {CellMonitor::kARFCN, "ARFCN", "GSMServingCell: Failed to retrieve ARFCN\n"},
};

void showMonitoredCell(TableSection& section, const LogPacket& data)
{
    showServingCell(section, data, {CellMonitor::kGSM}, kMonitorRows);
}

constexpr Reading kReadings[] = {
    {0x5134, Cell::minimumLength, kCellRows},
    {0x5137, Measurement::minimumLength, kMeasurementRows},
    {0x5076, LogCode_0x5076::minimumLength, kDedicatedRows},
    {kCellMonitorList, 0, {}, showMonitoredCell},
};
constexpr SectionDescription kDescription{"GSM Serving Cell", "GSMServingCell", kReadings};

} // namespace

GSMServingCell::GSMServingCell() : TableSection(kDescription) {}

} // namespace pelorus
