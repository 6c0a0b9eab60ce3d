#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

// Cell sets that have their place in the display but show no cell, meant so: every packet of cells empties
// them.

class DetectedSet : public TableSection {
public:
    DetectedSet();
};

class MonitoredSet : public TableSection {
public:
    MonitoredSet();
};

class VirtualActiveSet : public TableSection {
public:
    VirtualActiveSet();
};

} // namespace pelorus
