#pragma once

#include "telephonyd/simulation/MessageBatch.h"
#include "telephonyd/simulation/SoftHandover.h"

namespace pelorus {

/// The active set and the cells monitored beside it, 0x417A.
void writeUmtsCellSet(MessageBatch& log, const UmtsRadio& radio, const SoftHandover& activeSet);

/// UMTS cells ranked for reselection, 0x4005 without GSM cells. `serving`, if any, is favoured.
void writeRankedUmtsCells(MessageBatch& log, const UmtsRadio& radio, std::size_t serving);

/// 0x4127.
void writeUmtsServingCell(MessageBatch& log, std::size_t serving);

/// Samples of the last frames, 0x4031. The weaker the cell, the louder the handset.
void writeTransmitPower(MessageBatch& log, double rscp, Random& random);

constexpr std::size_t kNoUmtsCell = kUmtsCellCount;

} // namespace pelorus
