#include "LogGenerator/Osprey/GSM/ProcessCS.h"

#include "LogGenerator/Osprey/GSM/MobilityRows.h"

namespace pelorus {

namespace {

constexpr std::string_view kSubStates[] = {"MM_NULL_SUBSTATE",        "MM_NO_IMSI",
                                           "MM_PLMN_SEARCH",          "MM_LIMITED_SERVICE",
                                           "MM_ATTEMPTING_TO_UPDATE", "MM_LOCATION_UPDATE_NEEDED",
                                           "MM_NO_CELL_AVAILABLE",    "MM_PLMN_SEARCH_NORMAL_SERVICE",
                                           "MM_NORMAL_SERVICE"};
constexpr std::string_view kUpdateStatus[] = {"UPDATED", "NOT_UPDATED", "ROAMING_NOT_ALLOWED",
                                              "LOCATION_AREA_NOT_ALLOWED"};

using Layout = LogCode_0x7131;
constexpr Row kRows[] = {
    kMobilityStateRow,
    text("MM Sub State", Layout::subState, kSubStates, "Unknown"),
    text("LU Reject Cause", Layout::updateStatus, kUpdateStatus, "Unknown"),
};
constexpr Reading kReadings[] = {
    {0x7131, Layout::minimumLength, kRows},
    kRegistrationReading,
};
constexpr SectionDescription kDescription{"Process CS", "ProcessCS", kReadings};

} // namespace

ProcessCS::ProcessCS() : TableSection(kDescription) {}

} // namespace pelorus
