#pragma once

#include "LogGenerator/Osprey/LogPacket.h"
#include "LogGenerator/Osprey/Row.h"

#include <initializer_list>
#include <span>
#include <string_view>

namespace pelorus {

/// The cell list of the telephony server's cell monitor, code 0xFF0001: after the header a property list, an
/// array of cell dictionaries.
namespace CellMonitor {

constexpr std::string_view kRadioAccessTechnology = "CellMonitorCellRadioAccessTechnology";
constexpr std::string_view kGSM = "CellMonitorRadioAccessTechnologyGSM";
constexpr std::string_view kUMTS = "CellMonitorRadioAccessTechnologyUMTS";
constexpr std::string_view kUTRAN2 = "CellMonitorRadioAccessTechnologyUTRAN2";
constexpr std::string_view kLTE = "CellMonitorRadioAccessTechnologyLTE";

constexpr std::string_view kCellType = "CellMonitorCellType";
constexpr std::string_view kServing = "CellMonitorCellTypeServing";
constexpr std::string_view kNeighbor = "CellMonitorCellTypeNeighbor";

// Integers, or strings of decimal digits.
constexpr std::string_view kMCC = "CellMonitorMCC";
constexpr std::string_view kMNC = "CellMonitorMNC";
constexpr std::string_view kLAC = "CellMonitorLAC";
constexpr std::string_view kTAC = "CellMonitorTAC";
constexpr std::string_view kCellId = "CellMonitorCellId";
constexpr std::string_view kPID = "CellMonitorPID";           // physical cell identity
constexpr std::string_view kBandInfo = "CellMonitorBandInfo"; // band indicator
constexpr std::string_view kUARFCN = "CellMonitorUARFCN";
constexpr std::string_view kARFCN = "CellMonitorARFCN";
constexpr std::string_view kSCN = "CellMonitorSCN";   // primary scrambling code
constexpr std::string_view kRSSI = "CellMonitorRSSI"; // half dBm
constexpr std::string_view kRSCP = "CellMonitorRSCP"; // dBm
constexpr std::string_view kECN0 = "CellMonitorECN0"; // dB
constexpr std::int32_t kUnavailable = 32767;          // a measurement that is missing

} // namespace CellMonitor

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
