#include "LogGenerator/Osprey/LTE/LTEServingCellInfo.h"

#include "LogGenerator/Osprey/CellMonitor.h"
#include "LogGenerator/Osprey/LTE/LogCode_0xB0C1.h"
#include "LogGenerator/Osprey/LTE/LogCode_0xB0C2.h"

namespace pelorus {

namespace {

constexpr ValueText kBandwidth[] = {{6, "1.4 MHz"}, {15, "3 MHz"},  {25, "5 MHz"},
                                    {50, "10 MHz"}, {75, "15 MHz"}, {100, "20 MHz"}};

using Configuration = LogCode_0xB0C2;
constexpr Row kConfigurationRows[] = {
    number("Physical Cell ID", "%d", Configuration::physicalCellIdentity),
    number("Download Frequency", "%d", Configuration::downlinkEarfcn),
    number("Upload Frequency", "%d", Configuration::uplinkEarfcn),
    text("Download Bandwidth", Configuration::downlinkBandwidth, kBandwidth, "Unknown"),
    text("Upload Bandwidth", Configuration::uplinkBandwidth, kBandwidth, "Unknown"),
    number("Cell Identity", "%d", Configuration::cellIdentity),
    number("Tracking Area Code", "%d", Configuration::trackingAreaCode),
    number("Freq Band Indicator", "%d", Configuration::bandIndicator),
};
constexpr Row kAntennaRows[] = {number("Num Tx Antennas", "%d", LogCode_0xB0C1::transmitAntennas)};

constexpr CellRow kMonitorRows[] = {
    {CellMonitor::kTAC, "Tracking Area Code", "Serving Cell Info: Failed to retrieve TAC\n"},
    {CellMonitor::kCellId, "Cell Identity", "Serving Cell Info: Failed to retrieve Cell ID\n"},
    {CellMonitor::kPID, "Physical Cell ID", "Serving Cell Info: Failed to retrieve Physical Cell ID\n"},
    {CellMonitor::kBandInfo, "Freq Band Indicator",
     "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
    {CellMonitor::kUARFCN, "UARFCN", "Serving Cell Info: Failed to retrieve UARFCN\n"},
};

// Only the cell monitor tells the UARFCN; a new configuration makes it stale.
void dropMonitorFrequency(TableSection& section, const LogPacket&)
{
    section.entry()->remove("UARFCN");
}

// The line about an unknown code, after a packet that was decoded, is meant.
void logAsUnknown(TableSection&, const LogPacket&)
{
    TableSection::logUnknownCode(0xB0C1);
}

void showMonitoredCell(TableSection& section, const LogPacket& data)
{
    const Array* cells = requiredCellMonitorList(data);
    if (!cells)
        return;
    if (const Dictionary* cell = firstCell(*cells, {CellMonitor::kLTE}, CellMonitor::kServing))
        showCellRows(*section.entry(), kMonitorRows, *cell);
}

constexpr Reading kReadings[] = {
    {0xB0C2, Configuration::minimumLength, kConfigurationRows, dropMonitorFrequency, overtakesAlways},
    {0xB0C1, LogCode_0xB0C1::minimumLength, kAntennaRows, logAsUnknown, overtakesAlways},
    {kCellMonitorList, 0, {}, showMonitoredCell},
};
constexpr SectionDescription kDescription{"Serving Cell Info", "LTE Serving Cell Info", kReadings};

} // namespace

LTEServingCellInfo::LTEServingCellInfo() : TableSection(kDescription) {}

} // namespace pelorus
