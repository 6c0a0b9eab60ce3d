#include "LogGenerator/Osprey/UTRAN/GSMNeighbhorMeasurements.h"

#include "LogGenerator/Osprey/UTRAN/LogCode_0xD00E.h"

namespace pelorus {

namespace {

using Layout = LogCode_0xD00E;
using Cell = Layout::Cell;
constexpr Row kCellRows[] = {
    number("Cell ID", "%d", Cell::cellIdentity),
    number("Band Indicator", "%d", Cell::bandIndicator),
    number("BSIC Valid", "%d", Cell::bsicValid),
    number("NCC", "%d", Cell::networkColourCode),
    number("BCC", "%d", Cell::stationColourCode),
    number("ARFCN", "%d", Cell::arfcn),
    number("RSSI", "%d", Cell::rssi),
};

void readCells(TableSection& section, const LogPacket& data)
{
    const auto count = static_cast<std::size_t>(data[Layout::cellCount]);
    section.buildList(count, [&](std::size_t index, RowWriter& rows) {
        rows.show(kCellRows, data.record(Layout::cells, index, count)); // raises beyond the packet
        return false;                                                   // no cell is kept: meant
    });
}

constexpr Reading kReadings[] = {{0xD00E, Layout::minimumLength, {}, readCells}};
constexpr SectionDescription kDescription{"GSM Neighbor Cell List", "GSM Neighbor Cell List", kReadings,
                                          UnknownCode::ignored};

} // namespace

GSMNeighbhorMeasurements::GSMNeighbhorMeasurements() : TableSection(kDescription) {}

} // namespace pelorus
