#pragma once

#include <algorithm>
#include <array>
#include <string_view>

namespace pelorus {

/// What the leaves of the template name their rows by, in the order in which the decoders publish.
constexpr std::array kLookupKeys = std::to_array<std::string_view>({
    "kChannel",         "k1xEVDODeviceState", "kBandClass",       "kRxAGC0",         "kRxAGC1",
    "kTxAGC",           "kServingPNOffset",   "kSessionState",    "kUATI24",         "kColorCode",
    "kActiveSetPilots", "kFingerC2I",         "kFLDataRate",      "kRLDataRate",     "k1xDeviceState",
    "k1xRx0BandClass",  "k1xRx0ChanNum",      "k1xRxAGC0",        "k1xRx1BandClass", "k1xRx1ChanNum",
    "k1xRxAGC1",        "k1xTxAGC",           "k1xActiveSetInfo", "k1xTrafficFER",   "k1xRoamingHome",
    "kSystemId",        "kNetworkId",         "kPacketZoneId",    "kBaseId",         "kProtocolRevision",
});

/// One of kLookupKeys; a text that is none of them does not compile.
class LookupKey {
public:
    // NOLINTNEXTLINE(google-explicit-constructor): tables read better with the bare text
    template <std::size_t N> consteval LookupKey(const char (&name)[N])
    {
        const auto* const found = std::find(kLookupKeys.begin(), kLookupKeys.end(), std::string_view(name));
        if (found == kLookupKeys.end())
            throw "a key that no decoder publishes";
        place = static_cast<std::size_t>(found - kLookupKeys.begin());
    }
    constexpr std::size_t index() const { return place; }

private:
    std::size_t place = 0;
};

} // namespace pelorus
