#pragma once

#include "telephonyd/simulation/MessageBatch.h"

#include <cstdint>
#include <vector>

namespace pelorus {

/// A cell of any technology that the handset might reselect.
struct ReselectionCandidate {
    enum class Technology : std::uint16_t { lte, utran, geran, cdma1x };

    Technology technology = Technology::lte;
    std::uint16_t priority = 0;
    std::uint16_t channel = 0;  // EARFCN, UARFCN, ARFCN, CDMA channel
    std::uint16_t identity = 0; // physical cell identity, scrambling code, BSIC, pilot
    std::uint8_t band = 0;      // GERAN, CDMA
};

/// The candidates of an idle LTE handset, 0xB186. The records of that packet overlap: the fields of one lie
/// where the next one begins. So a packet carries one candidate (with its fields behind it), and the
/// candidates take turns; two go together only where what they share makes sense for both.
class LteReselectionCandidates {
public:
    /// Writes the next of the candidates, whose order should be stable. None: writes nothing.
    void write(MessageBatch& log, std::uint16_t servingEarfcn, std::uint16_t servingIdentity,
               const std::vector<ReselectionCandidate>& candidates);

private:
    std::size_t turn = 0;
};

} // namespace pelorus
