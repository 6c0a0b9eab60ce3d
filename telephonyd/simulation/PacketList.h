#pragma once

#include "platform/Value.h"

namespace pelorus {

/// A property list as packets of the telephony server carry it: binary. `list` is one.
std::vector<std::byte> packetList(const Value& list);

} // namespace pelorus
