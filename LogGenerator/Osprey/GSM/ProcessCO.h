#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// State of the registration and of circuit-switched mobility management, in brief.
class ProcessCO : public TableSection {
public:
    ProcessCO();
};

} // namespace pelorus
