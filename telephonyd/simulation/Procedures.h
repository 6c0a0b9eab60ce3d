#pragma once

#include "telephonyd/simulation/Signalling.h"

namespace pelorus {

enum class Activity : std::uint8_t { idle, call, data };

/// What a handset and the network of one technology do together, as its log tells it. Where it depends on
/// what the handset is doing, by Activity; empty where there is nothing to do.
struct Procedures {
    Procedure locationUpdate;
    Procedure routingAreaUpdate;
    std::array<Procedure, 3> cellChange; // within the technology
    std::array<Procedure, 3> leaving;    // for the other technology
    std::array<Procedure, 3> beginning;  // of the activity
    std::array<Procedure, 3> ending;
};

extern const Procedures kGsmProcedures;
extern const Procedures kUmtsProcedures;

/// Switched on, the handset searches the GSM bands and camps on a cell; then it is to register: a location
/// update, the attach, and the end of it.
extern const Procedure kSwitchOn;
extern const Procedure kAttach;
extern const Procedure kRegistrationEnds;

} // namespace pelorus
