#pragma once

#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The networks that count as the serving one, one dictionary a network.
class EquivalentPLMNList : public TableSection {
public:
    EquivalentPLMNList();
};

} // namespace pelorus
