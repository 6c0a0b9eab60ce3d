#include "LogGenerator/Osprey/GSM/HSDPAInformation.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x4221.h"

namespace pelorus {

namespace {

constexpr std::string_view kCarriers[] = {"Single Carrier", "MIMO", "Dual Carrier", "Reserved"};

using Layout = LogCode_0x4221;
using Process = Layout::Process;
constexpr Row kRows[] = {
    number("Version", "%u", Layout::version),
    number("Sub Frames", "%u", Layout::subFrameCount),
    text("Carrier Info", Layout::carriers, kCarriers, "Reserved"),
};
constexpr Row kProcessRows[] = {
    number("Process ID", "%u", Process::identity),
    number("No Rx Bits", "%u", Process::receivedBits),
    number("New Tx", "%u", Process::newTransmissions),
    number("Block Errors", "%u", Process::blockErrors),
};

// No process at all leaves the previous list: meant.
void showProcesses(TableSection& section, Label row, PacketView data, Records processes, std::size_t count)
{
    if (data.wholeRecords(processes, count) > 0)
        section.showList(*section.listRow(row), data, processes, count, kProcessRows);
}

std::size_t primaryProcesses(const LogPacket& data)
{
    return data.wholeRecords(Layout::primaryProcesses, static_cast<std::size_t>(data[Layout::primaryCount]));
}

std::size_t secondaryProcesses(const LogPacket& data)
{
    return data.wholeRecords(Layout::secondaryProcesses(static_cast<std::size_t>(data[Layout::primaryCount])),
                             static_cast<std::size_t>(data[Layout::secondaryCount]));
}

bool overtakesWithProcesses(const LogPacket& earlier, const LogPacket& later)
{
    return (primaryProcesses(later) > 0 || primaryProcesses(earlier) == 0) &&
           (secondaryProcesses(later) > 0 || secondaryProcesses(earlier) == 0);
}

void showBothCarriers(TableSection& section, const LogPacket& data)
{
    const auto primary = static_cast<std::size_t>(data[Layout::primaryCount]);
    const auto secondary = static_cast<std::size_t>(data[Layout::secondaryCount]);
    showProcesses(section, "Primary HARQ Process", data, Layout::primaryProcesses, primary);
    showProcesses(section, "Secondary HARQ Process", data, Layout::secondaryProcesses(primary), secondary);
}

constexpr Reading kReadings[] = {
    {0x4221, Layout::minimumLength, kRows, showBothCarriers, overtakesWithProcesses}};
constexpr SectionDescription kDescription{"HSDPA Info", "HSDPA Info", kReadings, UnknownCode::ignored};

} // namespace

HSDPAInformation::HSDPAInformation() : TableSection(kDescription) {}

} // namespace pelorus
