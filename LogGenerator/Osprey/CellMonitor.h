#pragma once

#include "LogGenerator/Osprey/CellMonitorKeys.h"
#include "LogGenerator/Osprey/LogPacket.h"
#include "LogGenerator/Osprey/Row.h"

#include <initializer_list>
#include <span>
#include <string_view>

namespace pelorus {

/// The list of a packet; null when there is none, which is logged when the payload cannot be read at all.
const Array* cellMonitorList(const LogPacket& data);

/// As cellMonitorList(), and logs "Failed to get Cell Array\n" when there is none.
const Array* requiredCellMonitorList(const LogPacket& data);

/// Whether `cell` is a dictionary whose technology is one of `technologies` and whose type is `type`.
bool isCell(const Value& cell, std::initializer_list<std::string_view> technologies, std::string_view type);

/// The first such cell of a list, or null.
const Dictionary* firstCell(const Array& cells, std::initializer_list<std::string_view> technologies,
                            std::string_view type);

/// A row that shows one number of a cell.
struct CellRow {
    std::string_view key;
    Label label;
    std::string_view missing; // error-level line when the number is absent or none; empty: no line
    Format format = "%d";
    int factor = 1;
    bool blankWhenUnavailable = false; // 32767 shows an empty text
};

/// Sets the rows whose numbers the cell has, and logs the others.
void showCellRows(Dictionary& entry, std::span<const CellRow> rows, const Dictionary& cell);
void showCellRows(RowWriter& entry, std::span<const CellRow> rows, const Dictionary& cell);

} // namespace pelorus
