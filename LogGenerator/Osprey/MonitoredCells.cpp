#include "LogGenerator/Osprey/MonitoredCells.h"

namespace pelorus {

void showServingCell(TableSection& section, const LogPacket& data,
                     std::initializer_list<std::string_view> technologies, std::span<const CellRow> rows)
{
    const Array* cells = requiredCellMonitorList(data);
    if (!cells)
        return;
    if (const Dictionary* cell = firstCell(*cells, technologies, CellMonitor::kServing))
        showCellRows(*section.entry(), rows, *cell);
}

void showNeighborCells(TableSection& section, const LogPacket& data, std::string_view technology,
                       std::span<const CellRow> rows)
{
    section.clearList();
    const Array* cells = requiredCellMonitorList(data);
    if (!cells)
        return;
    section.buildList(cells->elements.size(), [&](std::size_t index, RowWriter& writer) {
        const Value& cell = cells->elements[index];
        if (!isCell(cell, {technology}, CellMonitor::kNeighbor))
            return false;
        showCellRows(writer, rows, *cell.dictionary());
        return true;
    });
}

} // namespace pelorus
