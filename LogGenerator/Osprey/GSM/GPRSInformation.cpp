#include "LogGenerator/Osprey/GSM/GPRSInformation.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x5137.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51F4.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51F5.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51F6.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51FB.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51FD.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x7135.h"

namespace pelorus {

namespace {

constexpr ValueText kControlOrders[] = {{0, "NC0"}, {1, "NC1"}, {2, "NC2"}, {255, "Not Available"}};
constexpr ValueText kFlowContexts[] = {
    {0, "Not Supported"}, {1, "Supported"}, {255, "Available"}}; // not "Not Available": meant
constexpr ValueText kThresholds[] = {{0, "Barred (PKT access not allowed in the Cell)"},
                                     {1, "Barred"},
                                     {2, "Barred"},
                                     {3, "1 Only"},
                                     {4, "1 to 2"},
                                     {5, "1 to 3"},
                                     {6, "1 to 4"},
                                     {7, "Allowed"},
                                     {255, "Not Available"}};
constexpr std::string_view kOperatingModes[] = {"Class 1", "Class 2", "Class 3"};
constexpr std::string_view kT3192[] = {"500 ms", "1000 ms", "1500 ms", "0 ms",
                                       "80 ms",  "120 ms",  "160 ms",  "200 ms"};
constexpr std::string_view kShortBursts[] = {"8-bit format"};
constexpr std::string_view kNotSupported[] = {"Not Supported"};
constexpr ValueText kPositions[] = {
    {0, "Located on BCCH"}, {1, "Located on Extended BCCH"}, {255, "Not Available"}};
constexpr std::string_view kNotApplied[] = {"Not Applied"};

using Access = LogCode_0x51F5;
constexpr Row kAccessRows[] = {
    text("Network Control Order", Access::networkControlOrder, kControlOrders, "Unknown"),
    text("PFC Supported", Access::packetFlowContexts, kFlowContexts, "Unknown"),
    text("Priority Access Threshold", Access::priorityAccessThreshold, kThresholds, "Unknown"),
};
constexpr Row kModeRows[] = {
    text("Network Operating Mode", LogCode_0x7135::networkOperatingMode, kOperatingModes, "Unknown")};
using Timers = LogCode_0x51F6;
constexpr Row kTimerRows[] = {
    text("T3192", Timers::t3192, kT3192, "?? ms"),
    text("Access Burst Type", Timers::longAccessBursts, kShortBursts, "11-bit format"),
    number("DRX Timer Max", "%d", Timers::drxTimerMaximum),
};
constexpr Row kBroadcastRows[] = {number("PBCCH Present", "%d", LogCode_0x51FB::present)};
using Packet = LogCode_0x51FD;
constexpr Row kPacketRows[] = {
    number("Ext Measurement Order", "%d", Packet::extendedMeasurementOrder),
    number("Packet PSI Status", "%d", Packet::psiStatus),
    text("Packet SI Status", Packet::siStatus, kNotSupported, "Supported"),
    number("Count LR", "%d", Packet::countLR),
    number("Count HR", "%d", Packet::countHR),
};
constexpr Row kPositionRows[] = {text("SI13 Position", LogCode_0x51F4::position, kPositions, "Unknown")};
constexpr Row kHysteresisRows[] = {
    text("Cell Reselect Hysteresis", LogCode_0x5137::reselectHysteresis, kNotApplied, "Applied")};

constexpr Reading kReadings[] = {
    {0x51F5, Access::minimumLength, kAccessRows},
    {0x7135, LogCode_0x7135::minimumLength, kModeRows},
    {0x51F6, Timers::minimumLength, kTimerRows},
    {0x51FB, LogCode_0x51FB::minimumLength, kBroadcastRows},
    {0x51FD, Packet::minimumLength, kPacketRows},
    {0x51F4, LogCode_0x51F4::minimumLength, kPositionRows},
    {0x5137, LogCode_0x5137::minimumLength, kHysteresisRows},
};
constexpr SectionDescription kDescription{"GPRS Information", "GPRSInformation", kReadings};

} // namespace

GPRSInformation::GPRSInformation() : TableSection(kDescription) {}

} // namespace pelorus
