#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The GPRS options of the cell.
class GPRSInformation : public TableSection {
public:
    GPRSInformation();
};

} // namespace pelorus
