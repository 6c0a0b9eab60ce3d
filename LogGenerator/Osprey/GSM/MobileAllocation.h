#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The channels that the handset hops over.
class MobileAllocation : public TableSection {
public:
    MobileAllocation();
};

} // namespace pelorus
