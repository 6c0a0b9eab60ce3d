#include "telephonyd/simulation/NetworkPackets.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x7135.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x7150.h"

namespace pelorus {

namespace {

constexpr int kOperatingMode = 1; // class II: no common procedures of the two domains

constexpr int kFiller = 0xF;
constexpr int kCountryCode[] = {0, 0, 1};
constexpr int kNetworkCode[] = {0, 1, kFiller};
constexpr int kNetworkCodeInThreeDigits[] = {0, 0, 1};

} // namespace

void writeServingNetwork(MessageBatch& log, ServiceType service, RegistrationArea area)
{
    using Layout = LogCode_0x7135;
    PacketWriter packet = log.packet(0x7135, Layout::minimumLength);
    packet.put(Layout::networkOperatingMode, kOperatingMode);
    packet.put(Layout::serviceType, static_cast<std::int64_t>(service));
    for (std::size_t digit = 0; digit < 3; ++digit) {
        packet.put(Layout::countryCode[digit], kCountryCode[digit]);
        packet.put(Layout::networkCode[digit], kNetworkCode[digit]);
    }
    packet.put(Layout::locationAreaHigh, area.locationArea >> 8);
    packet.put(Layout::locationAreaLow, area.locationArea & 0xFF);
    packet.put(Layout::routingArea, area.routingArea);
}

void writeEquivalentNetworks(MessageBatch& log)
{
    using Layout = LogCode_0x7150;
    // The entries overlap: a second one would share half of its digits with the first. So there is one.
    PacketWriter packet = log.packet(0x7150, Layout::networks.start + Layout::networks.length);
    packet.put(Layout::networkCount, 1);
    PacketWriter network = packet.record(Layout::networks, 0);
    for (std::size_t digit = 0; digit < 3; ++digit) {
        network.put(Layout::Network::countryCode[digit], kCountryCode[digit]);
        network.put(Layout::Network::networkCode[digit], kNetworkCodeInThreeDigits[digit]);
    }
}

} // namespace pelorus
