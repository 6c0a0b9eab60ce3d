#pragma once

#include <cstdint>
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

} // namespace pelorus
