#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// Block errors of the transport channels.
class BLER : public TableSection {
public:
    BLER();
};

} // namespace pelorus
