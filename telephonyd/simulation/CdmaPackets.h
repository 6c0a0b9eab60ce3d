#pragma once

#include "telephonyd/simulation/MessageBatch.h"
#include "telephonyd/simulation/PilotSet.h"

namespace pelorus {

enum class CdmaState : std::uint8_t {
    inactive,
    initial = 2,
    acquisition,
    sync,
    slew,
    paging,
    sleep,
    traffic,
    unslew,
    powerUp = 11,
};

/// 0x119C.
void writeCdmaState(MessageBatch& log, CdmaState state, const CdmaCarrier& carrier, const PilotSet& pilots,
                    double transmitLevel);

/// 0x119D, one traffic frame.
void writeCdmaFrame(MessageBatch& log, bool isLost);

/// 0x134F.
void writeCdmaSystem(MessageBatch& log, std::size_t sector);

} // namespace pelorus
