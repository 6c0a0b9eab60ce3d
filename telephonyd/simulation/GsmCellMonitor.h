#pragma once

#include "telephonyd/simulation/CellMonitorList.h"
#include "telephonyd/simulation/GsmRadio.h"
#include "telephonyd/simulation/Random.h"
#include "telephonyd/simulation/UmtsRadio.h"

namespace pelorus {

/// The cell monitor's list of a GSM/UMTS handset: its serving cell, the neighbours of that technology, and
/// those of the other one, which it measures only now and then.
class GsmCellMonitor {
public:
    void writeInUmts(MessageBatch& log, const UmtsRadio& umts, std::size_t serving, const GsmRadio& gsm,
                     Random& random);
    void writeInGsm(MessageBatch& log, const GsmRadio& gsm, std::size_t serving, const UmtsRadio& umts,
                    Random& random);

private:
    void addUmtsNeighbours(const UmtsRadio& radio, std::size_t serving, double unmeasured, Random& random);
    void addGsmNeighbours(const GsmRadio& radio, std::size_t serving, double unmeasured, Random& random);

    CellMonitorList list;
};

} // namespace pelorus
