#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The GSM serving cell, from the baseband and from the cell monitor.
class GSMServingCell : public TableSection {
public:
    GSMServingCell();
};

} // namespace pelorus
