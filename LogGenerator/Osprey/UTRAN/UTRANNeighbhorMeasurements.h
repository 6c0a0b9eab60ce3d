#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The measured UTRAN neighbours, one dictionary a cell.
class UTRANNeighbhorMeasurements : public TableSection {
public:
    UTRANNeighbhorMeasurements();
};

} // namespace pelorus
