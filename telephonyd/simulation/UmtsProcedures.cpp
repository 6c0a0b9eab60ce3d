#include "telephonyd/simulation/ProcedureSteps.h"
#include "telephonyd/simulation/Procedures.h"

namespace pelorus {

namespace {

using namespace ProcedureSteps;
using enum HandsetEvent;

constexpr SignallingStep kLocationUpdate[] = {
    mm(60ms, MM_WAIT_FOR_RR_CONNECTION_LU, MM_LOCATION_UPDATE_NEEDED, NOT_UPDATED),
    rrc(10ms, RRC_CONNECTING),
    rrc(280ms, RRC_CELL_FACH),
    mm(30ms, MM_LOCATION_UPDATE_INITIATED, MM_LOCATION_UPDATE_NEEDED, NOT_UPDATED),
    ciphering(420ms, true),
    mm(600ms, MM_WAIT_FOR_NETWORK_COMMAND),
    event(10ms, locationUpdated),
    rrc(240ms, RRC_DISCONNECTED),
    ciphering(5ms, false),
    mm(20ms, MM_IDLE),
};

constexpr SignallingStep kRoutingAreaUpdate[] = {
    gmm(50ms, GMM_REGISTERED, GMM_UPDATE_NEEDED, NOT_UPDATED),
    rrc(10ms, RRC_CONNECTING),
    rrc(280ms, RRC_CELL_FACH),
    gmm(30ms, GMM_ROUTING_AREA_UPDATE_INITIATED, GMM_NULL_SUBSTATE, NOT_UPDATED),
    ciphering(380ms, true),
    gmm(520ms, GMM_REGISTERED),
    event(10ms, routingUpdated),
    rrc(220ms, RRC_DISCONNECTED),
    ciphering(5ms, false),
};

constexpr SignallingStep kCallSetup[] = {
    mm(0ms, MM_WAIT_FOR_RR_CONNECTION_MM),
    rrc(10ms, RRC_CONNECTING),
    rrc(310ms, RRC_CELL_DCH),
    event(5ms, callBegins),
    mm(30ms, MM_WAIT_FOR_OUTGOING_CONNECTION),
    ciphering(450ms, true),
    mm(380ms, MM_CONNECTION_ACTIVE),
};

constexpr SignallingStep kCallRelease[] = {
    mm(0ms, MM_WAIT_FOR_NETWORK_COMMAND),
    event(320ms, activityEnds),
    rrc(10ms, RRC_DISCONNECTED),
    ciphering(5ms, false),
    mm(20ms, MM_IDLE),
};

constexpr SignallingStep kDataSetup[] = {
    rrc(0ms, RRC_CONNECTING),     rrc(310ms, RRC_CELL_DCH),
    event(5ms, dataBegins),       gmm(30ms, GMM_SERVICE_REQUEST_INITIATED),
    ciphering(400ms, true),       gmm(250ms, GMM_REGISTERED),
    event(300ms, contextsChange),
};

// Nothing flows any more: the network takes the channels away bit by bit.
constexpr SignallingStep kDataRelease[] = {
    event(0ms, activityEnds),   rrc(10ms, RRC_CELL_FACH),     rrc(4000ms, RRC_CELL_PCH),
    rrc(5500ms, RRC_CELL_FACH), event(300ms, contextsChange), rrc(400ms, RRC_DISCONNECTED),
    ciphering(5ms, false),
};

constexpr SignallingStep kReselectionToGsm[] = {
    rr(0ms, RR_W2G_RESELECTION),
    event(750ms, gsmCellEntered),
    rr(10ms, RR_IDLE),
};

constexpr SignallingStep kHandoverToGsm[] = {
    rr(0ms, RR_W2G_HANDOVER),
    event(240ms, gsmCellEntered),
    event(10ms, trafficChannel),
    rrc(5ms, RRC_DISCONNECTED),
    ciphering(5ms, false),
    rr(10ms, RR_DATA_TRANSFER),
    gmm(40ms, GMM_REGISTERED, GMM_SUSPENDED),
};

constexpr SignallingStep kCellChangeOrderToGsm[] = {
    rrData(0ms, RR_W2G_CELL_CHANGE_ORDER),
    event(680ms, gsmCellEntered),
    rrc(5ms, RRC_DISCONNECTED),
    ciphering(5ms, false),
    rrData(10ms, RR_IDLE),
    rrData(60ms, RR_CONNECTION_PENDING),
    rrData(150ms, RR_DATA_TRANSFER),
};

} // namespace

const Procedures kUmtsProcedures = {
    .locationUpdate = kLocationUpdate,
    .routingAreaUpdate = kRoutingAreaUpdate,
    .cellChange = {}, // it just follows the signal
    .leaving = {kReselectionToGsm, kHandoverToGsm, kCellChangeOrderToGsm},
    .beginning = {Procedure(), kCallSetup, kDataSetup},
    .ending = {Procedure(), kCallRelease, kDataRelease},
};

} // namespace pelorus
