#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The state of the radio resource control.
class RRC_State : public TableSection {
public:
    RRC_State();
};

} // namespace pelorus
