#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// State of the UMTS radio-resource layer, and the serving cell from the baseband and from the cell monitor.
class UMTSRRInfo : public TableSection {
public:
    UMTSRRInfo();
};

} // namespace pelorus
