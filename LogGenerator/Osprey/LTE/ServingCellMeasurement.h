#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The serving cell in idle mode: its measurement and what reselection makes of it.
class ServingCellMeasurement : public TableSection {
public:
    ServingCellMeasurement();
};

} // namespace pelorus
