#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// HARQ statistics of HSDPA, for the primary and the secondary carrier.
class HSDPAInformation : public TableSection {
public:
    HSDPAInformation();
};

} // namespace pelorus
