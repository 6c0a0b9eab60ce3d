#pragma once

#include "telephonyd/simulation/MessageBatch.h"

namespace pelorus {

/// Where a handset is registered.
struct RegistrationArea {
    std::uint16_t locationArea = 0;
    std::uint8_t routingArea = 0;
};

/// The serving network, 001/01, 0x7135. Without an area there is limited service only.
void writeServingNetwork(MessageBatch& log, const RegistrationArea* area);

/// The equivalent networks, 0x7150: the home network alone.
void writeEquivalentNetworks(MessageBatch& log);

} // namespace pelorus
