#include "LogGenerator/Osprey/UTRAN/TRCHBLERMeasurement.h"

#include "LogGenerator/Osprey/UTRAN/LogCode_0xD00C.h"

namespace pelorus {

namespace {

using Layout = LogCode_0xD00C;
constexpr Row kChannelRows[] = {
    number("TRCH ID", "%d", Layout::TransportChannel::identity),
    number("TRCH BLER Measurement", "%d", Layout::TransportChannel::blockErrorRate),
};

void showChannels(TableSection& section, const LogPacket& data)
{
    const auto count = static_cast<std::size_t>(data[Layout::transportChannelCount]);
    section.buildList(count, [&](std::size_t index, RowWriter& rows) {
        rows.show(kChannelRows,
                  data.record(Layout::transportChannels, index, count)); // raises beyond the packet
        return true;
    });
}

constexpr Reading kReadings[] = {{0xD00C, Layout::minimumLength, {}, showChannels}};
constexpr SectionDescription kDescription{"TRCH BLER", "TRCH BLER Measurement", kReadings,
                                          UnknownCode::ignored, kLogNotice};

} // namespace

TRCHBLERMeasurement::TRCHBLERMeasurement() : TableSection(kDescription) {}

} // namespace pelorus
