#include "LogGenerator/Osprey/GSM/UMTSRRInfo.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x4031.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x4125.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x4127.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x4157.h"
#include "LogGenerator/Osprey/MonitoredCells.h"

#include <fmt/format.h>

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

/// The text of sum / samples in double precision.
void writeMean(std::int64_t sum, std::int64_t samples, std::string& shown)
{
    static constexpr Format kFormat = "%4.2f dBm";
    const bool endsInHalf = samples > 0 && sum * 200 % samples == 0 && sum * 200 / samples % 2 != 0;
    if (samples > 0 && !endsInHalf) {
        kFormat.writeFixed(shown, sum * Format::kOne / samples);
        return;
    }
    // Which way a half goes hangs on the double next to it. No sample is 0 / 0, shown as printf shows it:
    // meant.
    shown = fmt::format("{:4.2f} dBm", static_cast<double>(sum) / static_cast<double>(samples));
}

void showTransmitPower(TableSection& section, const LogPacket& data)
{
    using Layout = LogCode_0x4031;
    const std::size_t count =
        data.wholeRecords(Layout::samples, static_cast<std::size_t>(data[Layout::sampleCount]));
    std::int64_t sum = 0;
    std::int64_t samples = 0;
    for (std::size_t index = 0; index < count; ++index)
        if (const std::int64_t power = data.record(Layout::samples, index, count)[Layout::Sample::power]) {
            sum += (power + 512) / 10 - 70;
            ++samples;
        }
    writeMean(sum, samples, section.entry()->slot("Transmit Power").text());
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
    {0x4031, LogCode_0x4031::minimumLength, {}, showTransmitPower, overtakesAlways},
    {0x4127, Cell::minimumLength, kCellRows, dropMonitorFrequency, overtakesAlways},
    {0x4157, LogCode_0x4157::minimumLength, kCipheringRows},
    {kCellMonitorList, 0, {}, showMonitoredCell},
};
constexpr SectionDescription kDescription{"UMTS RR Info", "UMTSRRInfo", kReadings};

} // namespace

UMTSRRInfo::UMTSRRInfo() : TableSection(kDescription) {}

} // namespace pelorus
