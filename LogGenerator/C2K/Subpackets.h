#pragma once

#include "LogGenerator/Osprey/PacketView.h"

#include <optional>

namespace pelorus {

/// The first subpacket with that identifier, as much of it as the packet holds. Nothing when there is none,
/// or when it or one before it has a bad size, which is logged.
std::optional<PacketView> findSubpacket(PacketView data, unsigned identifier);

} // namespace pelorus
