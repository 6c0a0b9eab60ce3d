#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The network that the handset is registered in, from the baseband and from the cell monitor.
class ServingPLMN : public TableSection {
public:
    ServingPLMN();
};

} // namespace pelorus
