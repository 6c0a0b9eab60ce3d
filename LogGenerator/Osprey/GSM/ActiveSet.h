#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The UMTS cells of the active set, one dictionary a cell.
class ActiveSet : public TableSection {
public:
    ActiveSet();
};

} // namespace pelorus
