#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The neighbours measured in idle mode, one dictionary a cell.
class NeighborCellsList : public TableSection {
public:
    NeighborCellsList();
};

} // namespace pelorus
