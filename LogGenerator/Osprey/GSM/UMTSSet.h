#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The UMTS cells that reselection ranks, or the UMTS neighbours of the cell monitor, whichever came last.
class UMTSSet : public TableSection {
public:
    UMTSSet();
};

} // namespace pelorus
