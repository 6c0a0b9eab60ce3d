#include "LogGenerator/Osprey/LTE/MeasuredNeighborCells.h"

#include "LogGenerator/Osprey/LTE/LogCode_0xB179.h"

namespace pelorus {

namespace {

using Layout = LogCode_0xB179;
constexpr Row kCellRows[] = {
    number("Physical Cell ID", "%d", Layout::MeasuredCell::physicalCellIdentity),
    level("Filtered RSRP", "%4.2f dBm", Layout::MeasuredCell::rsrp, 0.25, -140.0),
    level("Filtered RSRQ", "%4.2f dB", Layout::MeasuredCell::rsrq, 0.125, -20.0),
};

void showCells(TableSection& section, const LogPacket& data)
{
    section.showList(data, Layout::measuredCells, static_cast<std::size_t>(data[Layout::measuredCount]),
                     kCellRows);
}

constexpr Reading kReadings[] = {{0xB179, Layout::minimumLength, {}, showCells, overtakesAlways}};
constexpr SectionDescription kDescription{"Measured Neighbor Cells", "Measured Neighbor Cells", kReadings};

} // namespace

MeasuredNeighborCells::MeasuredNeighborCells() : TableSection(kDescription) {}

} // namespace pelorus
