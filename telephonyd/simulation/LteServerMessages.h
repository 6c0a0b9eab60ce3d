#pragma once

#include "telephonyd/simulation/LteRadio.h"
#include "telephonyd/simulation/LteSurroundings.h"
#include "telephonyd/simulation/SubscriberMessages.h"

namespace pelorus {

/// What the telephony server itself adds to the log of an LTE handset: the SIM's files, the packet data
/// contexts, and the cell monitor's list.
class LteServerMessages {
public:
    explicit LteServerMessages(Random& random) : subscriber(random) {}

    void cellsAround(MessageBatch& log, const LteRadio& radio, const LteSurroundings& surroundings,
                     std::size_t serving);
    void contexts(MessageBatch& log, bool inSession);
    void sim(MessageBatch& log, std::size_t serving);

private:
    SubscriberMessages subscriber;
    CellMonitorList cellList;
    std::uint32_t knownCells = 0; // one bit each
};

} // namespace pelorus
