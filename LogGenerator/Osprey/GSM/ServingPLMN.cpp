#include "LogGenerator/Osprey/GSM/ServingPLMN.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x7132.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x7135.h"
#include "LogGenerator/Osprey/MonitoredCells.h"

namespace pelorus {

namespace {

constexpr std::string_view kSelectionModes[] = {"Automatic", "Manual", "Limited", "LIMITED_ROUTINE_ACQ",
                                                "LIMITED_MANUAL_ACQ"};
constexpr std::string_view kServiceTypes[] = {"NO_SERVICE", "CS_ONLY", "PS_ONLY", "CS_PS_SERVICE",
                                              "LIMITED_SERVICE"};

using Area = LogCode_0x7135;
constexpr Format kAreaCode = "%d";
constexpr Row kAreaRows[] = {
    number("Routing Area Code", "%d", Area::routingArea),
    text("Service Type", Area::serviceType, kServiceTypes, "Unknown"),
};
constexpr Row kSelectionRows[] = {
    text("PLMN Sel Mod", LogCode_0x7132::selectionMode, kSelectionModes, "Unknown")};

constexpr CellRow kMonitorRows[] = {
    {CellMonitor::kMCC, "Mobile Country Code", "ServingPLMN: Failed to retrieve MCC\n"},
    {CellMonitor::kMNC, "Mobile Network Code", "ServingPLMN: Failed to retrieve MNC\n"},
    {CellMonitor::kLAC, "Location Area Code", "ServingPLMN: Failed to retrieve LAC\n"},
};

// A filler becomes a blank, so a network code of two digits has one at its end: meant.
void writeDigits(std::string& out, PacketView data, std::span<const Field> digits)
{
    out.clear();
    for (const Field digit : digits)
        out.push_back(data[digit] < 10 ? static_cast<char>('0' + data[digit]) : ' ');
}

void showArea(TableSection& section, const LogPacket& data)
{
    Dictionary* const entry = section.entry();
    writeDigits(entry->slot("Mobile Country Code").text(), data, Area::countryCode);
    writeDigits(entry->slot("Mobile Network Code").text(), data, Area::networkCode);
    kAreaCode.write(entry->slot("Location Area Code").text(),
                    data[Area::locationAreaHigh] * 256 + data[Area::locationAreaLow]);
    showRows(*entry, kAreaRows, data);
}

void showMonitoredCell(TableSection& section, const LogPacket& data)
{
    showServingCell(section, data, {CellMonitor::kUMTS, CellMonitor::kGSM}, kMonitorRows);
}

constexpr Reading kReadings[] = {
    {0x7135, Area::minimumLength, {}, showArea, overtakesAlways},
    {0x7132, LogCode_0x7132::minimumLength, kSelectionRows},
    {kCellMonitorList, 0, {}, showMonitoredCell},
};
constexpr SectionDescription kDescription{"Serving PLMN", "Serving PLMN", kReadings};

} // namespace

ServingPLMN::ServingPLMN() : TableSection(kDescription) {}

} // namespace pelorus
