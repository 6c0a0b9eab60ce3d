#pragma once

#include "platform/Value.h"
#include "telephonyd/simulation/GsmRadio.h"
#include "telephonyd/simulation/UmtsRadio.h"

namespace pelorus {

// The sections of an IFX baseband's messages: groups, some of one entry only, and lists whose first element
// is their heading. Every value is a text.

std::shared_ptr<Dictionary> ifxServingCell(const GsmRadio& radio, std::size_t serving);
std::shared_ptr<Array> ifxNeighbours(const GsmRadio& radio, std::size_t serving);
/// Null when there is none that could be changed to.
std::shared_ptr<Array> ifxUmtsCells(const UmtsRadio& radio);
std::shared_ptr<Dictionary> ifxRadioResource(std::string_view state, bool hasService);

/// Of a connection with the network: what the handset hears and how far it is from the site.
struct IfxConnection {
    std::size_t serving = 0;
    double level = 0; // dBm
    int quality = 0;  // RXQUAL
    double metres = 0;
};
std::shared_ptr<Dictionary> ifxDedicatedChannel(const IfxConnection& connection);
std::shared_ptr<Dictionary> ifxPacketTransfer(const IfxConnection& connection);

} // namespace pelorus
