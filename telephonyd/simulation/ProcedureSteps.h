#pragma once

#include "telephonyd/simulation/Signalling.h"

namespace pelorus {

/// The vocabulary of the procedures: states as the log codes them. Only those that occur are named.
namespace ProcedureSteps {

using namespace std::chrono_literals;
using Milliseconds = std::chrono::milliseconds;

enum Registration : std::uint8_t { REG_INACTIVE, REG_IDLE, REG_REGISTERING, REG_AUTOMATIC_SEARCH = 5 };

enum Mm : std::uint8_t {
    MM_NULL = 0,
    MM_LOCATION_UPDATE_INITIATED = 3,
    MM_WAIT_FOR_OUTGOING_CONNECTION = 5,
    MM_CONNECTION_ACTIVE = 6,
    MM_WAIT_FOR_NETWORK_COMMAND = 9,
    MM_WAIT_FOR_RR_CONNECTION_LU = 13,
    MM_WAIT_FOR_RR_CONNECTION_MM = 14,
    MM_IDLE = 19,
};
enum MmSub : std::uint8_t {
    MM_NULL_SUBSTATE = 0,
    MM_PLMN_SEARCH = 2,
    MM_LOCATION_UPDATE_NEEDED = 5,
    MM_NORMAL_SERVICE = 8,
};

enum Gmm : std::uint8_t {
    GMM_NULL,
    GMM_DEREGISTERED,
    GMM_REGISTERED_INITIATED,
    GMM_REGISTERED,
    GMM_ROUTING_AREA_UPDATE_INITIATED = 5,
    GMM_SERVICE_REQUEST_INITIATED = 6,
};
enum GmmSub : std::uint8_t {
    GMM_NORMAL_SERVICE = 0,
    GMM_ATTACH_NEEDED = 2,
    GMM_PLMN_SEARCH = 6,
    GMM_SUSPENDED = 7,
    GMM_UPDATE_NEEDED = 8,
    GMM_NULL_SUBSTATE = 12,
};
enum UpdateStatus : std::uint8_t { UPDATED, NOT_UPDATED };

enum Rr : std::uint8_t {
    RR_INACTIVE = 0,
    RR_GOING_ACTIVE = 1,
    RR_GOING_INACTIVE = 2,
    RR_CELL_SELECTION = 3,
    RR_PLMN_LIST_CONSTRUCTION = 4,
    RR_IDLE = 5,
    RR_CELL_RESELECTION = 6,
    RR_CONNECTION_PENDING = 7,
    RR_CHOOSE_CELL = 8,
    RR_DATA_TRANSFER = 9,
    RR_CONNECTION_RELEASE = 11,
    RR_W2G_HANDOVER = 13,
    RR_W2G_RESELECTION = 14,
    RR_G2W_RESELECTION = 18,
    RR_W2G_CELL_CHANGE_ORDER = 21,
};
enum RrStatus : std::uint8_t { RR_NO_SERVICE, RR_SERVICE };

enum Rrc : std::uint8_t { RRC_DISCONNECTED, RRC_CONNECTING, RRC_CELL_FACH, RRC_CELL_DCH, RRC_CELL_PCH };

constexpr SignallingStep registration(Milliseconds after, Registration state)
{
    return {after, SignallingStep::Kind::registration, {state}};
}
constexpr SignallingStep mm(Milliseconds after, Mm state, MmSub subState = MM_NORMAL_SERVICE,
                            UpdateStatus status = UPDATED)
{
    return {after, SignallingStep::Kind::mm, {state, subState, status}};
}
constexpr SignallingStep gmm(Milliseconds after, Gmm state, GmmSub subState = GMM_NORMAL_SERVICE,
                             UpdateStatus status = UPDATED)
{
    return {after, SignallingStep::Kind::gmm, {state, subState, status}};
}
constexpr SignallingStep rr(Milliseconds after, Rr state, RrStatus status = RR_SERVICE)
{
    return {after, SignallingStep::Kind::rr, {state, status, 0}};
}
/// As rr(), for packet data.
constexpr SignallingStep rrData(Milliseconds after, Rr state)
{
    return {after, SignallingStep::Kind::rr, {state, RR_SERVICE, 1}};
}
constexpr SignallingStep rrc(Milliseconds after, Rrc state)
{
    return {after, SignallingStep::Kind::rrc, {state}};
}
constexpr SignallingStep ciphering(Milliseconds after, bool isOn)
{
    return {after, SignallingStep::Kind::ciphering, {isOn}};
}
constexpr SignallingStep event(Milliseconds after, HandsetEvent event)
{
    return {after, SignallingStep::Kind::event, {static_cast<std::uint8_t>(event)}};
}

} // namespace ProcedureSteps

} // namespace pelorus
