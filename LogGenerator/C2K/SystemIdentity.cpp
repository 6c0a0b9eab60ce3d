#include "LogGenerator/C2K/Decoders.h"
#include "LogGenerator/C2K/LogCode_0x134F.h"
#include "platform/SystemLog.h"

namespace pelorus {

namespace {

using Layout = LogCode_0x134F;

constexpr std::string_view kRoamingIndicators[] = {"OFF [0]",
                                                   "ON [1]",
                                                   "Flashing [2]",
                                                   "Out of Neighborhood [3]",
                                                   "Out of Building [4]",
                                                   "Preferred system [5]",
                                                   "Available system [6]",
                                                   "Alliance partner [7]",
                                                   "Premium partner [8]",
                                                   "Full service functionality [9]",
                                                   "Partial service functionality [10]",
                                                   "Banner ON [11]",
                                                   "Banner OFF [12]"};

constexpr PublishedRow kRoamingRow = {"k1xRoamingHome", "ERI - %d", Layout::roamingIndicator,
                                      kRoamingIndicators};
constexpr PublishedRow kKnownSystemRows[] = {
    {"kSystemId", "%d", Layout::systemIdentifier},
    {"kNetworkId", "%d", Layout::networkIdentifier},
};
constexpr PublishedRow kUnknownSystemRows[] = {
    {"kSystemId", "(unknown system type %d)", Layout::systemType},
    {"kNetworkId", "(unknown system type %d)", Layout::systemType},
};
constexpr PublishedRow kStationRows[] = {
    {"kPacketZoneId", "%d", Layout::packetZone},
    {"kBaseId", "%d", Layout::baseStation},
    {"kProtocolRevision", "%d", Layout::protocolRevision},
};

} // namespace

void decodeSystemIdentity(PacketView data, State&, const Lookup& lookup)
{
    if (!data.covers(Layout::minimumLength)) {
        systemLog(kLogError, "Log code 0x134f is %d bytes long but must be at least %lu bytes.", data.size(),
                  Layout::minimumLength);
        return;
    }
    if (data[Layout::version] < Layout::firstVersion) {
        systemLog(kLogError, "Log code 0x134f has version=%d; only version 2 or higher expected; dropping.",
                  data[Layout::version]);
        return;
    }
    lookup.show(kRoamingRow, data);
    lookup.show(data[Layout::systemType] == Layout::knownSystemType ? kKnownSystemRows : kUnknownSystemRows,
                data);
    lookup.show(kStationRows, data);
}

} // namespace pelorus
