#pragma once

#include "LogGenerator/Osprey/CellMonitor.h"
#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

// What the sections do that show cells of the cell monitor. Without a list they log and show nothing.

/// Sets the rows of the first serving cell of one of the technologies; none sets nothing.
void showServingCell(TableSection& section, const LogPacket& data,
                     std::initializer_list<std::string_view> technologies, std::span<const CellRow> rows);

/// Shows one dictionary for each neighbour of the technology. The old ones go even when there is no list.
void showNeighborCells(TableSection& section, const LogPacket& data, std::string_view technology,
                       std::span<const CellRow> rows);

} // namespace pelorus
