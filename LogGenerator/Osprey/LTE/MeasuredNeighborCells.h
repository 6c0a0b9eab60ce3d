#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The measured intra-frequency neighbours in connected mode, one dictionary a cell.
class MeasuredNeighborCells : public TableSection {
public:
    MeasuredNeighborCells();
};

} // namespace pelorus
