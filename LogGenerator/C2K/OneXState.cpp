#include "LogGenerator/C2K/BandClass.h"
#include "LogGenerator/C2K/Decoders.h"
#include "LogGenerator/C2K/LogCode_0x119C.h"
#include "LogGenerator/C2K/OneXActiveSet.h"
#include "LogGenerator/C2K/Subpackets.h"
#include "LogGenerator/C2K/TrafficErrorRate.h"
#include "platform/SystemLog.h"

namespace pelorus {

namespace {

using Layout = LogCode_0x119C;
using Radio = Layout::Radio;

constexpr std::string_view kStates[] = {"Inactive [0]",
                                        "Deep sleep in start state [1]",
                                        "Initial state for CDMA operation [2]",
                                        "Acquisition [3]",
                                        "Sync [4]",
                                        "Slew [5]",
                                        "Paging [6]",
                                        "Slotted mode sleep state [7]",
                                        "Traffic [8]",
                                        "UnSlew [9]",
                                        "Operation in PCG state [10]",
                                        "Powerup state [11]"};
constexpr std::int64_t kTraffic = 8; // the only state with a second chain and a transmitter

constexpr PublishedRow kStateRow = {"k1xDeviceState", "[Bad Value %d]", Layout::SystemState::deviceState,
                                    kStates};
constexpr PublishedRow kChain0Rows[] = {
    {"k1xRx0BandClass", kUnknownBandClass, Radio::bandClass0, kBandClasses},
    {"k1xRx0ChanNum", "%d", Radio::channel0},
};
constexpr PublishedRow kChain1Rows[] = {
    {"k1xRx1BandClass", kUnknownBandClass, Radio::bandClass1, kBandClasses},
    {"k1xRx1ChanNum", "%d", Radio::channel1},
};
constexpr LookupKey kTrafficKeys[] = {"k1xRx1BandClass", "k1xRx1ChanNum", "k1xRxAGC1", "k1xTxAGC"};
constexpr NumberText kLevel = "%+.2f dBm";
constexpr NumberText kOldErrorRate = "%.02f%% (old)";

double receiveLevel(std::int64_t raw)
{
    return static_cast<double>(raw) * 334.0 / 1000.0 - 63.248;
}

void showRadio(PacketView radio, bool inTraffic, const Lookup& lookup)
{
    lookup.show(kChain0Rows, radio);
    lookup.publish("k1xRxAGC0", kLevel, receiveLevel(radio.padded(Radio::receiveLevel0)));
    if (!inTraffic) {
        for (const LookupKey key : kTrafficKeys)
            lookup.publish(key, "N/A");
        return;
    }
    lookup.show(kChain1Rows, radio);
    lookup.publish("k1xRxAGC1", kLevel, receiveLevel(radio.padded(Radio::receiveLevel1)));
    lookup.publish("k1xTxAGC", kLevel, static_cast<double>(radio.padded(Radio::transmitLevel)) / 10.0);
}

/// Outside of traffic the rate ends, its last value stays in sight.
void endErrorRate(State& state, const Lookup& lookup)
{
    if (const auto rate = trafficErrorRate(state)) {
        lookup.publish("k1xTrafficFER", kOldErrorRate, 100.0 * double{*rate});
        forgetTrafficErrorRate(state);
    }
}

} // namespace

void decodeOneXState(PacketView data, State& state, const Lookup& lookup)
{
    if (!data.covers(Layout::minimumLength)) {
        systemLog(kLogError, "Log code 0x119c is %u bytes long but must be at least %lu bytes.", data.size(),
                  Layout::minimumLength);
        return;
    }
    const auto system = findSubpacket(data, Layout::SystemState::identifier);
    const auto radio = findSubpacket(data, Radio::identifier);
    const auto activeSet = findSubpacket(data, Layout::ActiveSet::identifier);
    const auto fingers = findSubpacket(data, Layout::Fingers::identifier); // required, and not read: meant
    if (!system || !radio || !activeSet || !fingers) {
        systemLog(kLogWarning, "Log code 0x119c: missing subpacket (ss=%d,rf=%d,ai=%d,fi=%d).",
                  system.has_value(), radio.has_value(), activeSet.has_value(), fingers.has_value());
        return;
    }
    const bool inTraffic = system->padded(Layout::SystemState::deviceState) == kTraffic;
    lookup.show(kStateRow, *system);
    showRadio(*radio, inTraffic, lookup);
    lookup.publish("k1xActiveSetInfo", oneXActiveSet(*activeSet, lookup.listShown("k1xActiveSetInfo")));
    if (!inTraffic)
        endErrorRate(state, lookup);
}

} // namespace pelorus
