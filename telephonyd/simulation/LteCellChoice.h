#pragma once

#include "telephonyd/simulation/LteRadio.h"

#include <optional>

namespace pelorus {

constexpr double kLteQrxlevmin = -124.0; // dBm, of all cells

/// Srxlev (3GPP TS 36.304, 5.2.3.2), without offsets.
double srxlev(const LteMeasurement& measured);

/// The cell that an idle handset would rather camp on (3GPP TS 36.304, 5.2.4): one of a carrier with higher
/// priority that is good enough, else a better one of the same carrier, else, where the serving cell is poor,
/// a good one of a carrier with lower priority. Only cells that can be measured now are eligible.
std::optional<std::size_t> reselectionTarget(const LteRadio& radio, std::size_t serving);

/// The neighbour that meets event A3 (3GPP TS 36.331, 5.5.4.4): better than the serving cell by an offset.
std::optional<std::size_t> handoverTarget(const LteRadio& radio, std::size_t serving);

/// Whether the carrier has worn so thin that the network sends a talking handset to another one.
bool isWornOut(const LteRadio& radio, std::size_t serving);

} // namespace pelorus
