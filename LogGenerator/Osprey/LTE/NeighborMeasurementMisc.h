#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// What the idle-mode neighbour measurement says of the frequency as a whole.
class NeighborMeasurementMisc : public TableSection {
public:
    NeighborMeasurementMisc();
};

} // namespace pelorus
