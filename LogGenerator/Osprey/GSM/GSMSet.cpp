#include "LogGenerator/Osprey/GSM/GSMSet.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x4005.h"

namespace pelorus {

namespace {

using Layout = LogCode_0x4005;
using Cell = Layout::GSMCell;
constexpr Row kCellRows[] = {
    number("ARFCN", "%d", Cell::arfcn),
    number("BSIC", "%d", Cell::bsic),
    number("RSSI", "%d dBm", Cell::rssi),
    number("Ranking Value", "%d", Cell::rankingValue),
};

void showCells(TableSection& section, const LogPacket& data)
{
    section.showList(data, Layout::gsmCells, static_cast<std::size_t>(data[Layout::gsmCellCount]), kCellRows);
}

constexpr Reading kReadings[] = {{0x4005, Layout::minimumLength, {}, showCells, overtakesAlways}};
constexpr SectionDescription kDescription{"GSM Set", "GSMSet", kReadings};

} // namespace

GSMSet::GSMSet() : TableSection(kDescription) {}

} // namespace pelorus
