#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The cells detected but not measured in connected mode, one dictionary a cell.
class DetectedCells : public TableSection {
public:
    DetectedCells();
};

} // namespace pelorus
