#pragma once

#include "telephonyd/simulation/GsmRadio.h"
#include "telephonyd/simulation/MessageBatch.h"

namespace pelorus {

/// C1 and C2 (3GPP TS 45.008, 6.4).
double pathLossCriterion(const GsmRadio& radio, std::size_t cell);
double reselectionCriterion(const GsmRadio& radio, std::size_t cell);

/// A new serving cell and what it says of GPRS: 0x5134, 0x51F4, 0x51F5, 0x51F6, 0x51FB, 0x51FD.
void writeGsmServingCell(MessageBatch& log, std::size_t serving);

/// The identities of the cells around, 0x51FF.
void writeStationIdentities(MessageBatch& log, const RankedGsmCells& neighbours);

/// Idle-mode measurement, 0x5137.
void writeGsmIdleMeasurement(MessageBatch& log, const GsmRadio& radio, std::size_t serving,
                             const RankedGsmCells& neighbours);

/// Receive qualities of a frame, and of its part that is sent in silence too (RXQUAL 0 to 7).
struct GsmQuality {
    int full;
    int sub;
};

/// Dedicated-mode measurement, 0x5137.
void writeGsmDedicatedMeasurement(MessageBatch& log, const GsmRadio& radio, std::size_t serving,
                                  GsmQuality quality, const RankedGsmCells& neighbours);

/// GSM cells ranked for reselection, 0x4005 without UMTS cells.
void writeRankedGsmCells(MessageBatch& log, const GsmRadio& radio, const RankedGsmCells& cells);

/// The channel of dedicated mode, 0x5076.
void writeDedicatedChannel(MessageBatch& log, std::uint16_t arfcn);

/// A hopping traffic channel of the cell, 0x51F8.
void writeHopping(MessageBatch& log, std::size_t serving);

/// 0x5072.
void writeDiscontinuousTransmission(MessageBatch& log, bool isUsed);

} // namespace pelorus
