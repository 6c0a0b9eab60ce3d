#pragma once

#include "telephonyd/simulation/MessageBatch.h"
#include "telephonyd/simulation/PilotSet.h"

#include <optional>

namespace pelorus {

enum class EvdoState : std::uint8_t { inactive, acquisition, sync, idle, access, connected };
enum class EvdoSession : std::uint8_t { closed, ampSetup, terminalNegotiates, networkNegotiates, open };

/// What 0x1183 tells beside the radio.
struct EvdoSummary {
    EvdoState state = EvdoState::inactive;
    EvdoSession session = EvdoSession::closed;
    std::optional<std::size_t> serving; // sector
    double transmitLevel = 0;           // dBm
    std::uint32_t accessTerminal = 0;   // 24 bits of the UATI
    std::uint8_t colorCode = 0;
};

/// 0x1183.
void writeEvdoSummary(MessageBatch& log, const CdmaCarrier& carrier, const EvdoSummary& summary);

/// 0x12B6.
void writeEvdoPilots(MessageBatch& log, const CdmaCarrier& carrier, const PilotSet& pilots);

/// 0x108A. The strongest paths of the pilots get the fingers.
void writeEvdoFingers(MessageBatch& log, const CdmaCarrier& carrier, const PilotSet& pilots, Random& random);

} // namespace pelorus
