#include "telephonyd/simulation/EvdoLink.h"

#include "LogGenerator/C2K/LogCode_0x1192.h"
#include "LogGenerator/C2K/LogCode_0x127E.h"
#include "telephonyd/simulation/MessageBatch.h"

#include <algorithm>
#include <cmath>

namespace pelorus {

namespace {

/// What the handset asks for at a C/I (DRC), by rising rate. The counters of each stand side by side: its
/// packet sizes from small to large, then what was lost.
struct ForwardRate {
    double neededRatio; // dB, where one packet in a hundred is lost
    std::uint8_t slots; // of 1.67 ms, of a packet
    std::uint8_t firstCounter;
    std::uint8_t lostCounter;
};
constexpr ForwardRate kRates[] = {
    {-11.5, 16, 5, 9}, // 38.4 kbit/s
    {-9.2, 8, 10, 14}, // 76.8
    {-6.5, 4, 15, 19}, // 153.6
    {-3.8, 2, 20, 24}, // 307.2
    {-0.8, 2, 34, 37}, // 614.4, 2048 bits
    {1.5, 2, 38, 40},  // 921.6
    {3.8, 2, 45, 46},  // 1228.8
    {6.0, 2, 52, 53},  // 1536
    {7.6, 1, 47, 49},  // 1843.2
    {9.8, 1, 50, 51},  // 2457.6
    {11.8, 1, 54, 55}, // 3072
};
constexpr double kMargin = 1.0; // dB
constexpr double kSlotsPerSecond = 600;
constexpr double kShareMean = 0.4;
constexpr double kShareDeviation = 0.12;
constexpr double kShareMemory = 8.0; // seconds
constexpr double kLoss = 0.01;
constexpr double kTrickle = 6.0; // packets a second when nobody waits for any

// Reverse link: a packet takes up to four subpackets of 6.67 ms, most are through with the third.
constexpr double kSubpacketsPerSecond = 150;
constexpr double kThrough[] = {0.04, 0.16, 0.5, 0.3};
constexpr double kMeanSubpackets = 0.04 * 1 + 0.16 * 2 + 0.5 * 3 + 0.3 * 4;
constexpr double kReservePerPayload = 2.5; // dB
constexpr int kPayloadOfAnswers = 3;       // while pages come
constexpr int kPayloadOfUploads = 9;

/// A whole number near the mean.
std::uint32_t drawn(double mean, Random& random)
{
    return static_cast<std::uint32_t>(
        std::max(0.0, std::floor(mean + std::sqrt(mean) * 0.5 * random.normal() + random.uniform())));
}

} // namespace

void EvdoLink::changeDemand(double seconds, Random& random)
{
    demandEnds -= seconds;
    if (demandEnds > 0)
        return;
    const bool pauses = demand != Demand::none;
    demandEnds = pauses ? random.between(1, 6) : random.between(3, 12);
    demand = pauses ? Demand::none : random.chance(0.2) ? Demand::up : Demand::down;
}

void EvdoLink::advance(double seconds, double ratio, double reserve, Random& random)
{
    share.advance(Fading(seconds, kShareMemory), random);
    changeDemand(seconds, random);
    receive(seconds, ratio, random);
    send(seconds, reserve, random);
}

void EvdoLink::receive(double seconds, double ratio, Random& random)
{
    const ForwardRate* rate = nullptr;
    for (const ForwardRate& possible : kRates)
        if (ratio - kMargin > possible.neededRatio)
            rate = &possible;
    if (!rate)
        return; // too weak for any
    if (demand != Demand::down) {
        forward[rate->firstCounter] += drawn(kTrickle * seconds, random);
        return;
    }
    const double mine = std::clamp(kShareMean + kShareDeviation * share.now(), 0.1, 0.8);
    const std::uint32_t packets = drawn(kSlotsPerSecond * mine * seconds / rate->slots, random);
    forward[rate->lostCounter - 1U] += packets; // the largest size
    forward[rate->lostCounter] += random.chance(packets * kLoss) ? 1 : 0;
}

void EvdoLink::send(double seconds, double reserve, Random& random)
{
    const int wanted = demand == Demand::up     ? kPayloadOfUploads
                       : demand == Demand::down ? kPayloadOfAnswers
                                                : 0;
    const int affordable = static_cast<int>(std::max(reserve, 0.0) / kReservePerPayload);
    auto& payload = reverse[static_cast<std::size_t>(std::min(wanted, affordable))];
    const double packets =
        (demand == Demand::none ? kTrickle : kSubpacketsPerSecond / kMeanSubpackets) * seconds;
    for (std::size_t subpacket = 0; subpacket < kSubpackets; ++subpacket)
        payload[subpacket] += drawn(packets * kThrough[subpacket], random);
}

void EvdoLink::write(MessageBatch& log, std::uint32_t sequenceNumber) const
{
    using Forward = LogCode_0x1192;
    using Reverse = LogCode_0x127E;
    static_assert(Forward::recordCount == kForwardCounters && Reverse::weights.size() == kPayloads &&
                  Reverse::countersPerRecord == kSubpackets);
    PacketWriter received = log.packet(0x1192, Forward::minimumLength);
    received.put(Forward::sequenceNumber, sequenceNumber);
    for (std::size_t index = 0; index < kForwardCounters; ++index)
        received.record(Forward::counters, index).put(u32(0), forward[index]);

    PacketWriter sent = log.packet(0x127E, Reverse::minimumLength);
    sent.put(Reverse::sequenceNumber, sequenceNumber);
    for (std::size_t index = 0; index < kPayloads; ++index)
        for (std::uint32_t subpacket = 0; subpacket < kSubpackets; ++subpacket)
            sent.record(Reverse::counters, index).put(u32(4 * subpacket), reverse[index][subpacket]);
}

} // namespace pelorus
