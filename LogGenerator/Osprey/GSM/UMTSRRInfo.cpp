#include "LogGenerator/Osprey/GSM/UMTSRRInfo.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x4031.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x4125.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x4127.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x4157.h"
#include "LogGenerator/Osprey/MonitoredCells.h"

#include <fmt/format.h>
#include <iterator>

namespace pelorus {

namespace {

constexpr std::string_view kStates[] = {"Disconnected", "Connecting", "CELL_FACH",
                                        "CELL_DCH",     "CELL_PCH",   "URA_PCH"};
constexpr std::string_view kDisabled[] = {"Disabled"};

constexpr Row kStateRows[] = {text("RRC State", LogCode_0x4125::state, kStates, "Unknown")};
using Cell = LogCode_0x4127;
constexpr Row kCellRows[] = {
    number("Cell ID", "%d", Cell::cellIdentity),
    number("Downlink Frequency", "%d", Cell::downlinkUarfcn),
    number("Uplink Frequency", "%d", Cell::uplinkUarfcn),
    number("URA ID", "%d", Cell::registrationArea),
};
constexpr Row kCipheringRows[] = {text("Ciphering", LogCode_0x4157::ciphering, kDisabled, "Enabled")};
constexpr CellRow kMonitorRows[] = {
    {CellMonitor::kCellId, "Cell ID", "UMTSRRInfo: Failed to retrieve Cell ID\n"},
    {CellMonitor::kUARFCN, "UARFCN", "UMTSRRInfo: Failed to retrieve UARFCN\n"},
    {CellMonitor::kSCN, "Scrambling Code", "UMTSRRInfo: Failed to retrieve Scrambling Code\n"},
};

void showTransmitPower(TableSection& section, const LogPacket& data)
{
    using Layout = LogCode_0x4031;
    const std::size_t count =
        data.wholeRecords(Layout::samples, static_cast<std::size_t>(data[Layout::sampleCount]));
    double sum = 0;
    int samples = 0;
    for (std::size_t index = 0; index < count; ++index)
        if (const std::int64_t power = data.record(Layout::samples, index, count)[Layout::Sample::power]) {
            sum += static_cast<double>((power + 512) / 10 - 70);
            ++samples;
        }
    Dictionary* const entry = section.entry();
    std::string& shown = entry->slot("Transmit Power").text();
    shown.clear();
    // Without a sample this is 0 / 0, and shown as printf shows that: meant.
    fmt::format_to(std::back_inserter(shown), "{:4.2f} dBm", sum / samples);
}

// Only the cell monitor tells the UARFCN; a new cell makes it stale.
void dropMonitorFrequency(TableSection& section, const LogPacket&)
{
    section.entry()->remove("UARFCN");
}

void showMonitoredCell(TableSection& section, const LogPacket& data)
{
    showServingCell(section, data, {CellMonitor::kUMTS}, kMonitorRows);
}

constexpr Reading kReadings[] = {
    {0x4125, LogCode_0x4125::minimumLength, kStateRows},
    {0x4031, LogCode_0x4031::minimumLength, {}, showTransmitPower},
    {0x4127, Cell::minimumLength, kCellRows, dropMonitorFrequency},
    {0x4157, LogCode_0x4157::minimumLength, kCipheringRows},
    {kCellMonitorList, 0, {}, showMonitoredCell},
};
constexpr SectionDescription kDescription{"UMTS RR Info", "UMTSRRInfo", kReadings};

} // namespace

UMTSRRInfo::UMTSRRInfo() : TableSection(kDescription) {}

} // namespace pelorus
