#pragma once

#include "telephonyd/simulation/LteCellList.h"
#include "telephonyd/simulation/MessageBatch.h"

namespace pelorus {

/// What the baseband keeps between two idle-mode measurements.
struct LteMeasurementRules {
    int rules = 0; // bit 0 own carrier, bit 1 carriers of lower priority, bit 2 of higher
    bool updated = false;
    int weakCycles = 0; // DRX cycles in a row without enough level
};

/// Configuration and master information of a new serving cell, 0xB0C2 and 0xB0C1.
void writeServingCell(MessageBatch& log, std::size_t serving);

/// Idle-mode measurement of the serving cell, 0xB17F.
void writeServingMeasurement(MessageBatch& log, const LteRadio& radio, std::size_t serving,
                             const LteMeasurementRules& rules);

/// Idle-mode measurement of 1 to 32 cells of one carrier, 0xB180.
void writeNeighbours(MessageBatch& log, const LteRadio& radio, std::size_t serving, std::size_t carrier,
                     const LteCellList& cells, double frequencyOffset);

/// Connected-mode measurement of the serving cell's carrier, 0xB179.
void writeConnectedMeasurement(MessageBatch& log, const LteRadio& radio, std::size_t serving,
                               const LteCellList& measured, const LteCellList& detected, int subframe);

/// Whole steps from `lowest` to the level, rounded; not below 0.
int stepsAbove(double lowest, double level, double stepsPerUnit);

} // namespace pelorus
