#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// State of the registration and of packet-switched mobility management.
class ProcessPS : public TableSection {
public:
    ProcessPS();
};

} // namespace pelorus
