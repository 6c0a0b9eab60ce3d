#include "LogGenerator/Osprey/LTE/DetectedCells.h"

#include "LogGenerator/Osprey/LTE/LogCode_0xB179.h"

namespace pelorus {

namespace {

using Layout = LogCode_0xB179;
constexpr Row kCellRows[] = {number("Physical Cell ID", "%d", Layout::DetectedCell::physicalCellIdentity)};

void showCells(TableSection& section, const LogPacket& data)
{
    const auto measured = static_cast<std::size_t>(data[Layout::measuredCount]);
    section.showList(data, Layout::detectedCells(measured),
                     static_cast<std::size_t>(data[Layout::detectedCount]), kCellRows);
}

constexpr Reading kReadings[] = {{0xB179, Layout::minimumLength, {}, showCells, overtakesAlways}};
constexpr SectionDescription kDescription{"Detected Cells", "Detected Cells", kReadings};

} // namespace

DetectedCells::DetectedCells() : TableSection(kDescription) {}

} // namespace pelorus
