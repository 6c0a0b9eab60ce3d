#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// State of the registration and of circuit-switched mobility management.
class ProcessCS : public TableSection {
public:
    ProcessCS();
};

} // namespace pelorus
