#pragma once

#include <cstdint>
#include <string>

namespace pelorus {

/// The kinds of cell that a cell-monitor list tells of.
enum class CellKind { none, gsm, umts, lte };

/// Of the bits of ModemManager's AccessTechnologies; none when the modem is not on a network, or on one whose
/// cells nothing here shows. LTE with 5G beside it is LTE.
CellKind servingKind(std::uint32_t accessTechnologies);

/// The answer to "GetTechnology" while the modem is on such a cell; empty for none.
std::string technologyOn(CellKind kind);

/// The answer while the modem has not been on any, by what it is able to: CurrentCapabilities. Empty for a
/// modem that can none of them.
std::string technologyAbleTo(std::uint32_t capabilities);

/// Bits of CurrentModes in words, the newest generation first: "LTE, UMTS, GSM". Empty for none or any.
std::string modesText(std::uint32_t modes);

} // namespace pelorus
