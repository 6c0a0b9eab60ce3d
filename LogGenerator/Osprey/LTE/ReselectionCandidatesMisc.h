#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The serving cell that the reselection candidates are compared with.
class ReselectionCandidatesMisc : public TableSection {
public:
    ReselectionCandidatesMisc();
};

} // namespace pelorus
