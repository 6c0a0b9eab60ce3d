#include "LogGenerator/Osprey/GSM/ProcessPS.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x7130.h"
#include "LogGenerator/Osprey/GSM/MobilityRows.h"

namespace pelorus {

namespace {

constexpr std::string_view kStates[] = {"GMM_NULL",
                                        "GMM_DEREGISTERED",
                                        "GMM_REGISTERED_INITIATED",
                                        "GMM_REGISTERED",
                                        "GMM_DEREGISTERED_INITIATED",
                                        "GMM_ROUTING_AREA_UPDATE_INITIATED",
                                        "GMM_SERVICE_REQUEST_INITIATED"};
constexpr std::string_view kSubStates[] = {"GMM_NORMAL_SERVICE",
                                           "GMM_LIMITED_SERVICE",
                                           "GMM_ATTACH_NEEDED",
                                           "GMM_ATTEMPTING_TO_ATTACH",
                                           "GMM_NO_IMSI",
                                           "GMM_NO_CELL_AVAILABLE",
                                           "GMM_PLMN_SEARCH",
                                           "GMM_SUSPENDED",
                                           "GMM_UPDATE_NEEDED",
                                           "GMM_ATTEMPING_TO_UPDATE", // spelled so on purpose
                                           "GMM_ATTEMPTING_TO_UPDATE_MM",
                                           "GMM_IMSI_DETACH_INITIATED",
                                           "GMM_NULL_SUBSTATE"};
constexpr std::string_view kUpdateStatus[] = {"GMM_GU1_UPDATED", "GMM_GU2_NOT_UPDATED",
                                              "GMM_GU3_PLMN_NOT_ALLOWED", "GMM_GU3_ROUTING_AREA_NOT_ALLOWED"};

using Layout = LogCode_0x7130;
constexpr Row kRows[] = {
    text("MM State", Layout::state, kStates, "Unknown"),
    text("MM Sub State", Layout::subState, kSubStates, "Unknown"),
    text("Attach Reject Cause", Layout::updateStatus, kUpdateStatus, "Unknown"),
};
constexpr Reading kReadings[] = {
    {0x7130, Layout::minimumLength, kRows},
    kRegistrationReading,
};
constexpr SectionDescription kDescription{"Process PS", "ProcessPS", kReadings};

} // namespace

ProcessPS::ProcessPS() : TableSection(kDescription) {}

} // namespace pelorus
