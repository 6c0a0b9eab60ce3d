#pragma once

#include "LogGenerator/Osprey/PacketView.h"
#include "platform/Value.h"

namespace pelorus {

/// The pilots of the active-set subpacket of a 1x state and the Ec/Io of each; the mark alone when there are
/// none. `shown` is the list that is shown now, or null.
std::shared_ptr<Dictionary> oneXActiveSet(PacketView activeSet, const Dictionary* shown);

} // namespace pelorus
