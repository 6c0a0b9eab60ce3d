#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The signal-to-interference values of the coded composite transport channels, one dictionary a channel.
class CCTRCHSIRMeasurement : public TableSection {
public:
    CCTRCHSIRMeasurement();
};

} // namespace pelorus
