#pragma once

#include "LogGenerator/Osprey/GSM/ArfcnToBsic.h"
#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

/// The GSM neighbours that the baseband measures, or those of the cell monitor, whichever came last.
class NeighboringCells : public TableSection {
public:
    NeighboringCells();

    /// The base-station identities decoded last; they reach the display with the next measurement.
    ArfcnToBsic arfcnToBsic;
};

} // namespace pelorus
