#include "LogGenerator/Osprey/GSM/BLER.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x4116.h"

namespace pelorus {

namespace {

using Layout = LogCode_0x4116;
constexpr Row kRows[] = {number("Window Size", "%d", Layout::windowSize)};
constexpr Row kChannelRows[] = {
    number("Transport Channel ID", "%d", Layout::Channel::identity),
    number("CRC Received", "%d", Layout::Channel::received),
    number("CRC Received in Error", "%d", Layout::Channel::inError),
};

void showChannels(TableSection& section, const LogPacket& data)
{
    section.showList(*section.listRow("Transport Channels"), data, Layout::channels,
                     static_cast<std::size_t>(data[Layout::channelCount]), kChannelRows);
}

constexpr Reading kReadings[] = {{0x4116, Layout::minimumLength, kRows, showChannels, overtakesAlways}};
constexpr SectionDescription kDescription{"BLER", "BLER", kReadings};

} // namespace

BLER::BLER() : TableSection(kDescription) {}

} // namespace pelorus
