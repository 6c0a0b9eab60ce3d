#include "LogGenerator/Osprey/GSM/MobileAllocation.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x51F8.h"

namespace pelorus {

namespace {

using Layout = LogCode_0x51F8;
constexpr Format kArfcn = "%d";
constexpr Row kRows[] = {number("HSN", "%d", Layout::hoppingSequence)};

void showChannels(TableSection& section, const LogPacket& data)
{
    const std::size_t count =
        data.wholeRecords(Layout::channels, static_cast<std::size_t>(data[Layout::channelCount]));
    section.buildTexts(*section.listRow("ARFCNs"), count, [&](std::size_t index, std::string& text) {
        kArfcn.write(text, data.record(Layout::channels, index, count)[Layout::Channel::arfcn]);
    });
}

constexpr Reading kReadings[] = {{0x51F8, Layout::minimumLength, kRows, showChannels, overtakesAlways}};
constexpr SectionDescription kDescription{"Mobile Allocation", "MobileAllocation", kReadings};

} // namespace

MobileAllocation::MobileAllocation() : TableSection(kDescription) {}

} // namespace pelorus
