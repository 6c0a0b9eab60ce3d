#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The measured GSM neighbours. They are decoded, and a packet that contradicts itself raises, but the list
/// stays empty: meant.
class GSMNeighbhorMeasurements : public TableSection {
public:
    GSMNeighbhorMeasurements();
};

} // namespace pelorus
