#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The filtered measurement of the serving cell in connected mode.
class ConnectedModeMeasurementMisc : public TableSection {
public:
    ConnectedModeMeasurementMisc();
};

} // namespace pelorus
