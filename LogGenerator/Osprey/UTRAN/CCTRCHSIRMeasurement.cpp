#include "LogGenerator/Osprey/UTRAN/CCTRCHSIRMeasurement.h"

#include "LogGenerator/Osprey/UTRAN/LogCode_0xD00C.h"

namespace pelorus {

namespace {

using Layout = LogCode_0xD00C;
using Channel = Layout::CompositeChannel;
constexpr Row kChannelRows[] = {
    number("CCTRCH ID", "%d", Channel::identity),
    number("TSNUM", "%d", Channel::timeslot),
};
constexpr Format kSir = "%d";

/// Makes `row` the list of a channel's SIR values, in the list that it may hold already.
void showSirValues(Value& row, PacketView channel)
{
    if (!row.array())
        row = makeArray();
    auto& texts = row.array()->elements;
    texts.resize(Channel::sirCount);
    for (std::size_t position = 0; position < Channel::sirCount; ++position)
        writeNumber(kSir, channel.record(Channel::sirValues, position, Channel::sirCount)[Channel::sir],
                    texts[position]);
}

void showChannels(TableSection& section, const LogPacket& data)
{
    const auto count = static_cast<std::size_t>(data[Layout::compositeChannelCount]);
    const Records channels =
        Layout::compositeChannels(static_cast<std::size_t>(data[Layout::transportChannelCount]));
    section.buildList(count, [&](std::size_t index, RowWriter& rows) {
        const PacketView channel = data.record(channels, index, count); // raises beyond the packet
        rows.show(kChannelRows, channel);
        showSirValues(rows.next("SIR"), channel);
        return true;
    });
}

constexpr Reading kReadings[] = {{0xD00C, Layout::minimumLength, {}, showChannels}};
constexpr SectionDescription kDescription{"CCTRCH SIR", "CCTRCH SIR Measurement", kReadings,
                                          UnknownCode::ignored};

} // namespace

CCTRCHSIRMeasurement::CCTRCHSIRMeasurement() : TableSection(kDescription) {}

} // namespace pelorus
