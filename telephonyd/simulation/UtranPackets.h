#pragma once

#include "telephonyd/simulation/GsmRadio.h"
#include "telephonyd/simulation/MessageBatch.h"
#include "telephonyd/simulation/UtranTraffic.h"

namespace pelorus {

enum class UtranMode : std::uint8_t { disconnected, connecting, cellFach, cellDch, cellPch, uraPch };

/// 0xD0E0.
void writeUtranMode(MessageBatch& log, UtranMode mode);

/// 0xD0E2.
void writeUtranServingCell(MessageBatch& log, std::size_t serving);

/// 0xD00A. The serving cell is the active set of the connected handset.
void writeUtranNeighbours(MessageBatch& log, const UtranRadio& radio, std::size_t serving, bool isConnected);

/// 0xD00E.
void writeUtranGsmNeighbours(MessageBatch& log, const GsmRadio& radio);

/// 0xD00C.
void writeTransportChannels(MessageBatch& log, const UtranTraffic& traffic);

} // namespace pelorus
