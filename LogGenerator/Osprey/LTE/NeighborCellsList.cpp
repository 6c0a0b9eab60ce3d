#include "LogGenerator/Osprey/LTE/NeighborCellsList.h"

#include "LogGenerator/Osprey/LTE/LogCode_0xB180.h"

namespace pelorus {

namespace {

using Layout = LogCode_0xB180;
using Cell = Layout::Cell;
constexpr Row kCellRows[] = {
    number("Physical Cell ID", "%d", Cell::physicalCellIdentity),
    level("Measured RSSI", "%4.2f dBm", Cell::measuredRssi, 0.5, -140.0),
    level("Measured RSRP", "%4.2f dBm", Cell::measuredRsrp, 0.5,
          -140.0), // half dB, unlike the serving cell's
    level("Average RSRP", "%4.2f dBm", Cell::averageRsrp, 0.5, -140.0),
    level("Measured RSRQ", "%4.2f dB", Cell::measuredRsrq, 0.25, -30.0),
    level("Average RSRQ", "%4.2f dB", Cell::averageRsrq, 0.25, -30.0),
    number("Srxlev", "%d dBm", Cell::srxlev, {1, -30}),
    number("Frequency Offset", "%d", Cell::frequencyOffset),
    number("Ant 0 Frame Offset", "%d", Cell::frameOffset),
    number("Ant 0 Sample Offset", "%d", Cell::sampleOffset),
    number("Ant 1 Frame Offset", "%d", Cell::frameOffset), // the same bits again: meant
    number("Ant 1 Sample Offset", "%d", Cell::sampleOffset),
};

void logCell(PacketView cell)
{
    systemLog(kLogWarning, "Physical Cell ID: %d\n", static_cast<int>(cell[Cell::physicalCellIdentity]));
    for (const Row& row : kCellRows)
        if (row.kind == Row::Kind::fixed) // one label for all five: meant
            systemLog(kLogWarning, "Measured RSSI: %lf\n",
                      static_cast<double>(cell[row.field] * row.scale + row.offset) / double{Format::kOne});
}

void showCells(TableSection& section, const LogPacket& data)
{
    const auto count = static_cast<std::size_t>(data[Layout::cellsLessOne]) + 1;
    systemLog(kLogWarning, "Number of neighboring cells being reported: %d\n", static_cast<int>(count));
    if (systemLogListens())
        for (std::size_t index = 0; index < data.wholeRecords(Layout::cells, count); ++index)
            logCell(data.record(Layout::cells, index, count));
    section.showList(data, Layout::cells, count, kCellRows);
}

constexpr Reading kReadings[] = {{0xB180, Layout::minimumLength, {}, showCells, overtakesAlways}};
constexpr SectionDescription kDescription{"Neighbor Cells List", "Neighbor Cells List", kReadings};

} // namespace

NeighborCellsList::NeighborCellsList() : TableSection(kDescription) {}

} // namespace pelorus
