#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// Identity and frequencies of the serving UTRAN cell, from the baseband and from the cell monitor.
class UTRANServingCellInfo : public TableSection {
public:
    UTRANServingCellInfo();
};

} // namespace pelorus
