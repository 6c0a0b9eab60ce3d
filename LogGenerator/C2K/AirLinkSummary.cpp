#include "LogGenerator/C2K/BandClass.h"
#include "LogGenerator/C2K/Decoders.h"
#include "LogGenerator/C2K/LogCode_0x1183.h"
#include "platform/SystemLog.h"

namespace pelorus {

namespace {

using Layout = LogCode_0x1183;

constexpr std::string_view kDeviceStates[] = {"Inactive [0]", "Acquisition [1]", "Sync [2]",
                                              "Idle [3]",     "Access [4]",      "Connected [5]"};
constexpr std::int64_t kAccess = 4; // the first state with a second chain and a transmitter
constexpr std::string_view kSessionStates[] = {"Closed [0]", "AMP setup [1]", "AT-initiated neg [2]",
                                               "Initiated neg [3]", "Open [4]"};
constexpr ValueText kNoPilot[] = {{0xFFFF, "Invalid Value"}};

constexpr PublishedRow kSectorRows[] = {
    {"kChannel", "%d", Layout::channel},
    {"k1xEVDODeviceState", "[Reserved %d]", Layout::deviceState, kDeviceStates},
    {"kBandClass", kUnknownBandClass, Layout::bandClass, kBandClasses},
    {"kRxAGC0", "%+d dBm", Layout::receiveLevel0},
};
constexpr PublishedRow kAccessRows[] = {
    {"kRxAGC1", "%+d dBm", Layout::receiveLevel1},
    {"kTxAGC", "%+d dBm", Layout::transmitLevel},
};
constexpr PublishedRow kSessionRows[] = {
    {"kServingPNOffset", "%d × 64chips", Layout::servingPilot, kNoPilot},
    {"kSessionState", "[Reserved %d]", Layout::sessionState, kSessionStates},
    {"kUATI24", "0x%06x", Layout::accessTerminal},
    {"kColorCode", "%d", Layout::colorCode},
};

} // namespace

void decodeAirLinkSummary(PacketView data, State&, const Lookup& lookup)
{
    if (data.size() != Layout::length) {
        systemLog(kLogError, "Log code 0x1183 is %u bytes long but should be %lu bytes.", data.size(),
                  Layout::length);
        return;
    }
    lookup.show(kSectorRows, data);
    if (data[Layout::deviceState] < kAccess) {
        lookup.publish("kRxAGC1", "N/A");
        lookup.publish("kTxAGC", "N/A");
    } else {
        lookup.show(kAccessRows, data);
    }
    lookup.show(kSessionRows, data);
}

} // namespace pelorus
