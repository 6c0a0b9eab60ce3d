#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// Identity, frequencies and bandwidths of the serving cell, from the baseband and from the cell monitor.
class LTEServingCellInfo : public TableSection {
public:
    LTEServingCellInfo();
};

} // namespace pelorus
