#pragma once

#include "telephonyd/simulation/MessageBatch.h"

namespace pelorus {

/// Where a handset is registered.
struct RegistrationArea {
    std::uint16_t locationArea = 0;
    std::uint8_t routingArea = 0;
};

enum class ServiceType : std::uint8_t { none, csOnly, psOnly, csAndPs, limited };

/// The serving network, 001/01, 0x7135.
void writeServingNetwork(MessageBatch& log, ServiceType service, RegistrationArea area);

/// The equivalent networks, 0x7150: the home network alone.
void writeEquivalentNetworks(MessageBatch& log);

} // namespace pelorus
