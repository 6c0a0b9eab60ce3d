#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// State of the GSM radio-resource layer.
class GSMRRInfo : public TableSection {
public:
    GSMRRInfo();
};

} // namespace pelorus
