#include "LogGenerator/C2K/Decoders.h"
#include "LogGenerator/C2K/LogCode_0x119D.h"
#include "LogGenerator/C2K/Subpackets.h"
#include "LogGenerator/C2K/TrafficErrorRate.h"
#include "platform/SystemLog.h"

namespace pelorus {

namespace {

using Layout = LogCode_0x119D;

constexpr float kNewestFrame = 0.015625F; // 1 of 64
constexpr float kFramesBefore = 0.984375F;
constexpr NumberText kRate = "%.02f%%";

} // namespace

void decodeOneXTraffic(PacketView data, State& state, const Lookup& lookup)
{
    if (!data.covers(Layout::minimumLength)) {
        systemLog(kLogError, "Log code 0x119d is %d bytes long but must be at least %ld bytes.", data.size(),
                  Layout::minimumLength);
        return;
    }
    const auto demodulator = findSubpacket(data, Layout::TrafficDemodulator::identifier);
    if (!demodulator) {
        systemLog(kLogWarning, "Log code 0x119d: missing traffic demod subpacket.");
        return;
    }
    float rate = demodulator->padded(Layout::TrafficDemodulator::frameError) != 0 ? kNewestFrame : 0.0F;
    if (const auto before = trafficErrorRate(state))
        rate += *before * kFramesBefore;
    setTrafficErrorRate(state, rate);
    lookup.publish("k1xTrafficFER", kRate, 100.0 * double{rate});
}

} // namespace pelorus
