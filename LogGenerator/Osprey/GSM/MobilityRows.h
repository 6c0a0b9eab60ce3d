#pragma once

#include "LogGenerator/Osprey/GSM/LogCode_0x7131.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x7132.h"
#include "LogGenerator/Osprey/TableSection.h"

namespace pelorus {

// What several of the mobility-management sections show alike.

inline constexpr std::string_view kRegistrationStates[] = {
    "REG_STATE_INACTIVE",      "REG_STATE_IDLE",          "REG_STATE_REGISTERING",
    "REG_STATE_DEREGISTERING", "REG_STATE_MANUAL_SEARCH", "REG_STATE_AUTOMATIC_SEARCH",
    "REG_STATE_OFFLINE"};
inline constexpr Row kRegistrationRows[] = {
    text("MM Service State", LogCode_0x7132::registrationState, kRegistrationStates, "Unknown")};
inline constexpr Reading kRegistrationReading{0x7132, LogCode_0x7132::minimumLength, kRegistrationRows};

// The blanks within two of the texts are meant, and so are the gaps.
inline constexpr ValueText kMobilityStates[] = {
    {0, "MM_NULL"},
    {3, "MM_LOCATION_UPDATE_INITIATED"},
    {5, "MM_WAIT_FOR_OUTGOING_MM_CONNECTION"},
    {6, "MM_CONNECTION_ACTIVE"},
    {7, "MM_IMSI_DETACH_INITIATED"},
    {8, "MM_PROCESS_CM_SERVICE_PROMPT"},
    {9, "MM_WAIT_FOR_NETWORK_COMMAND"},
    {10, "MM_LOCATION_UPDATE_REJECTED"},
    {13, "MM_WAIT_FOR_RR_CONNECTION_LU"},
    {14, "MM_WAIT_FOR_RR_CONNECTION_MM"},
    {15, "MM_WAIT_FOR_RR_CONNECTION_IMSI_DETACH"},
    {17, "MM_REESTABLISHMENT_INITIATED"},
    {18, "MM_WAIT_FOR_RR_ACTIVE"},
    {19, "MM_IDLE"},
    {20, "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION"},
    {21, "MM_WAIT_FOR_RR_CONNECTION_ REESTABLISHMENT"},
    {22, "MM_WAIT_FOR_REESTABLISH_DECISION"},
    {23, "MM_LOCATION_UPDATING_PENDING"},
    {25, "MM_RR_CONNECTION_RELEASE_NOT_ALLOWED"},
};
inline constexpr Row kMobilityStateRow = text("MM State", LogCode_0x7131::state, kMobilityStates, "Unknown");

} // namespace pelorus
