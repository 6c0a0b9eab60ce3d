#include "LogGenerator/Osprey/UTRAN/UTRANNeighbhorMeasurements.h"

#include "LogGenerator/Osprey/UTRAN/LogCode_0xD00A.h"

namespace pelorus {

namespace {

constexpr std::string_view kSets[] = {"ASET", "MSET", "DSET"}; // a cell of no set has no such row
constexpr std::string_view kTruth[] = {"FALSE", "TRUE"};

using Layout = LogCode_0xD00A;
using Cell = Layout::Cell;
constexpr Row kCellRows[] = {
    number("UARFCN", "%d", Cell::uarfcn),
    number("Cell ID", "%d", Cell::cellIdentity),
    level("Filter RSCP", "%f", Cell::filteredRscp, 0.00390625, 0.0),
    text("Status", Cell::setMembership, kSets, {}),
    text("inJDCS", Cell::inJdcsList, kTruth, {}),
};

void showCells(TableSection& section, const LogPacket& data)
{
    const auto count = static_cast<std::size_t>(data[Layout::cellCount]);
    section.buildList(count, [&](std::size_t index, RowWriter& rows) {
        rows.show(kCellRows, data.record(Layout::cells, index, count)); // raises beyond the packet
        return true;
    });
}

constexpr Reading kReadings[] = {{0xD00A, Layout::minimumLength, {}, showCells}};
constexpr SectionDescription kDescription{"Neighbor Cell List", "NeighbhorMeasurements List", kReadings,
                                          UnknownCode::ignored};

} // namespace

UTRANNeighbhorMeasurements::UTRANNeighbhorMeasurements() : TableSection(kDescription) {}

} // namespace pelorus
