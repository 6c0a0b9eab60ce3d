#include "LogGenerator/Osprey/GSM/GSMRRInfo.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x5072.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x512C.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x5137.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51F6.h"

namespace pelorus {

namespace {

// The blanks within three of the texts are meant.
constexpr std::string_view kStates[] = {"RR_INACTIVE",
                                        "RR_GOING_ACTIVE",
                                        "RR_GOING_INACTIVE",
                                        "RR_CELL_SELECTION",
                                        "RR_PLMN_LIST_CONSTRUCTION",
                                        "RR_IDLE",
                                        "RR_CELL_RESELECTION",
                                        "RR_CONNECTION_PENDING",
                                        "RR_CHOOSE_CELL",
                                        "RR_DATA_TRANSFER",
                                        "RR_NO_CHANNELS",
                                        "RR_CONNECTION_RELEASE",
                                        "RR_EARLY_CAMPED_WAIT_FOR_SI",
                                        "RR_W2G_INTERRAT_HANDOVER_ PROGRESS",
                                        "RR_W2G_INTERRAT_RESELECTION_PROGRESS",
                                        "RR_WAIT_FOR_EARLY_PSCAN",
                                        "GRR51",
                                        "GRR52",
                                        "RR_G2W_INTERRAT_RESELECTION_PROGRESS",
                                        "RR_G2W_INTERRAT_HANDOVER_ PROGRESS",
                                        "RR_CELL_REEST",
                                        "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS"};
constexpr std::string_view kVoice[] = {"Voice"};
constexpr std::string_view kOff[] = {"OFF"};

using State = LogCode_0x512C;
constexpr Row kStateRows[] = {
    text("RR State", State::state, kStates, "Unknown"),
    number("RR Sub State", "%d", State::subState),
    number("RR Status", "%d", State::status),
    text("RR Mode", State::dataMode, kVoice, "Data"),
};
using Measurement = LogCode_0x5137;
constexpr Row kMeasurementRows[] = {
    number("Serving Rx Level", "%d", Measurement::receiveLevel),
    number("Rx Quality Full", "%d", Measurement::receiveQualityFull),
    number("Rx Quality Sub", "%d", Measurement::receiveQualitySub),
};
constexpr Row kTransmissionRows[] = {text("DTX Used", LogCode_0x5072::discontinuousTransmission, kOff, "ON")};
constexpr Row kTimerRows[] = {number("DRX Used", "%d sec", LogCode_0x51F6::drxTimerMaximum)};

constexpr Reading kReadings[] = {
    {0x512C, State::minimumLength, kStateRows},
    {0x5137, Measurement::minimumLength, kMeasurementRows},
    {0x5072, LogCode_0x5072::minimumLength, kTransmissionRows},
    {0x51F6, LogCode_0x51F6::minimumLength, kTimerRows},
};
constexpr SectionDescription kDescription{"GSM RR Info", "GSMRRInfo", kReadings};

} // namespace

GSMRRInfo::GSMRRInfo() : TableSection(kDescription) {}

} // namespace pelorus
