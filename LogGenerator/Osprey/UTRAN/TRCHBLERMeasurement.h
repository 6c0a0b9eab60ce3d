#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The block error rates of the transport channels, one dictionary a channel.
class TRCHBLERMeasurement : public TableSection {
public:
    TRCHBLERMeasurement();
};

} // namespace pelorus
