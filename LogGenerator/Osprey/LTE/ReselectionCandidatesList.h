#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The idle-mode reselection candidates of any technology, one dictionary a candidate.
class ReselectionCandidatesList : public TableSection {
public:
    ReselectionCandidatesList();
};

} // namespace pelorus
