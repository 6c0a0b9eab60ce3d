#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The GSM cells that reselection ranks, one dictionary a cell.
class GSMSet : public TableSection {
public:
    GSMSet();
};

} // namespace pelorus
