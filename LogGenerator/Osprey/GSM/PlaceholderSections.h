#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

// Sections that have their place in the display but subscribe to nothing.

class CellChangeCounters : public TableSection {
public:
    CellChangeCounters();
};

class CodingScheme : public TableSection {
public:
    CodingScheme();
};

class NonRankedGSMSet : public TableSection {
public:
    NonRankedGSMSet();
};

class NonRankedUMTSSet : public TableSection {
public:
    NonRankedUMTSSet();
};

class UMTSRRMeasurement : public TableSection {
public:
    UMTSRRMeasurement();
};

} // namespace pelorus
