#include "telephonyd/simulation/ProcedureSteps.h"
#include "telephonyd/simulation/Procedures.h"

namespace pelorus {

namespace {

using namespace ProcedureSteps;
using enum HandsetEvent;

constexpr SignallingStep kSwitchOnSteps[] = {
    registration(0ms, REG_INACTIVE),
    mm(5ms, MM_NULL, MM_NULL_SUBSTATE, NOT_UPDATED),
    gmm(5ms, GMM_NULL, GMM_NULL_SUBSTATE, NOT_UPDATED),
    rrc(5ms, RRC_DISCONNECTED),
    rr(5ms, RR_INACTIVE, RR_NO_SERVICE),
    registration(400ms, REG_AUTOMATIC_SEARCH),
    mm(10ms, MM_IDLE, MM_PLMN_SEARCH, NOT_UPDATED),
    gmm(10ms, GMM_DEREGISTERED, GMM_PLMN_SEARCH, NOT_UPDATED),
    rr(20ms, RR_GOING_ACTIVE, RR_NO_SERVICE),
    rr(150ms, RR_PLMN_LIST_CONSTRUCTION, RR_NO_SERVICE),
    rr(2100ms, RR_CELL_SELECTION, RR_NO_SERVICE),
    rr(450ms, RR_CHOOSE_CELL, RR_NO_SERVICE),
    event(380ms, gsmCellEntered),
    rr(10ms, RR_IDLE),
    registration(30ms, REG_REGISTERING),
    mm(10ms, MM_IDLE, MM_LOCATION_UPDATE_NEEDED, NOT_UPDATED),
    gmm(10ms, GMM_DEREGISTERED, GMM_ATTACH_NEEDED, NOT_UPDATED),
};

constexpr SignallingStep kRegistrationEndsSteps[] = {
    event(20ms, registered),
    registration(20ms, REG_IDLE),
};

constexpr SignallingStep kLocationUpdate[] = {
    mm(60ms, MM_WAIT_FOR_RR_CONNECTION_LU, MM_LOCATION_UPDATE_NEEDED, NOT_UPDATED),
    rr(15ms, RR_CONNECTION_PENDING),
    event(260ms, signallingChannel),
    rr(10ms, RR_DATA_TRANSFER),
    mm(40ms, MM_LOCATION_UPDATE_INITIATED, MM_LOCATION_UPDATE_NEEDED, NOT_UPDATED),
    mm(1150ms, MM_WAIT_FOR_NETWORK_COMMAND),
    event(10ms, locationUpdated),
    rr(270ms, RR_CONNECTION_RELEASE),
    mm(30ms, MM_IDLE),
    rr(60ms, RR_IDLE),
};

constexpr SignallingStep kAttachSteps[] = {
    rrData(80ms, RR_CONNECTION_PENDING),
    rrData(140ms, RR_DATA_TRANSFER),
    gmm(20ms, GMM_REGISTERED_INITIATED, GMM_NULL_SUBSTATE, NOT_UPDATED),
    gmm(1400ms, GMM_REGISTERED),
    event(10ms, routingUpdated),
    rrData(200ms, RR_CONNECTION_RELEASE),
    rr(40ms, RR_IDLE),
};

constexpr SignallingStep kRoutingAreaUpdate[] = {
    gmm(50ms, GMM_REGISTERED, GMM_UPDATE_NEEDED, NOT_UPDATED),
    rrData(20ms, RR_CONNECTION_PENDING),
    rrData(140ms, RR_DATA_TRANSFER),
    gmm(20ms, GMM_ROUTING_AREA_UPDATE_INITIATED, GMM_NULL_SUBSTATE, NOT_UPDATED),
    gmm(900ms, GMM_REGISTERED),
    event(10ms, routingUpdated),
    rrData(180ms, RR_CONNECTION_RELEASE),
    rr(40ms, RR_IDLE),
};

constexpr SignallingStep kReselection[] = {
    rr(0ms, RR_CELL_RESELECTION),
    event(420ms, gsmCellEntered),
    rr(10ms, RR_IDLE),
};

constexpr SignallingStep kCallSetup[] = {
    mm(0ms, MM_WAIT_FOR_RR_CONNECTION_MM),
    rr(10ms, RR_CONNECTION_PENDING),
    event(240ms, signallingChannel),
    rr(10ms, RR_DATA_TRANSFER),
    gmm(15ms, GMM_REGISTERED, GMM_SUSPENDED),
    mm(20ms, MM_WAIT_FOR_OUTGOING_CONNECTION),
    mm(950ms, MM_CONNECTION_ACTIVE),
    event(480ms, trafficChannel),
    event(0ms, callBegins),
};

constexpr SignallingStep kCallRelease[] = {
    mm(0ms, MM_WAIT_FOR_NETWORK_COMMAND),
    event(350ms, activityEnds),
    rr(10ms, RR_CONNECTION_RELEASE),
    mm(20ms, MM_IDLE),
    rr(80ms, RR_IDLE),
    gmm(30ms, GMM_REGISTERED),
};

constexpr SignallingStep kHandover[] = {
    event(100ms, gsmCellEntered),
    event(20ms, trafficChannel),
};

constexpr SignallingStep kDataSetup[] = {
    rrData(0ms, RR_CONNECTION_PENDING),
    rrData(160ms, RR_DATA_TRANSFER),
    event(20ms, dataBegins),
    event(650ms, contextsChange),
};

constexpr SignallingStep kDataRelease[] = {
    event(0ms, activityEnds),
    event(200ms, contextsChange),
    rrData(150ms, RR_CONNECTION_RELEASE),
    rr(40ms, RR_IDLE),
};

constexpr SignallingStep kDataReselection[] = {
    rrData(0ms, RR_CELL_RESELECTION),    event(380ms, gsmCellEntered),    rrData(10ms, RR_IDLE),
    rrData(60ms, RR_CONNECTION_PENDING), rrData(150ms, RR_DATA_TRANSFER),
};

constexpr SignallingStep kReselectionToUmts[] = {
    rr(0ms, RR_G2W_RESELECTION),
    event(620ms, umtsCellEntered),
    rr(10ms, RR_GOING_INACTIVE),
    rr(60ms, RR_INACTIVE),
};

} // namespace

const Procedures kGsmProcedures = {
    .locationUpdate = kLocationUpdate,
    .routingAreaUpdate = kRoutingAreaUpdate,
    .cellChange = {kReselection, kHandover, kDataReselection},
    .leaving = {kReselectionToUmts, {}, {}},
    .beginning = {Procedure(), kCallSetup, kDataSetup},
    .ending = {Procedure(), kCallRelease, kDataRelease},
};

const Procedure kSwitchOn = kSwitchOnSteps;
const Procedure kAttach = kAttachSteps;
const Procedure kRegistrationEnds = kRegistrationEndsSteps;

} // namespace pelorus
