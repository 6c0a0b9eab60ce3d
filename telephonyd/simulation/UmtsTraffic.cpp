#include "telephonyd/simulation/UmtsTraffic.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x4116.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x4221.h"

#include <algorithm>
#include <cmath>

namespace pelorus {

namespace {

constexpr double kSubFramesPerSecond = 500;
constexpr double kScheduled = 0.6;      // share of the sub-frames that are for this handset
constexpr double kDualCarrier = 0.5;    // of the data sessions
constexpr double kBlockErrorRate = 0.1; // first transmissions, what link adaptation aims at
constexpr int kWindow = 100;            // blocks
constexpr std::uint8_t kHarqVersion = 1;
constexpr int kSingleCarrierCode = 0;
constexpr int kDualCarrierCode = 2;

/// Bits of a block at that quality, along the CQI tables (3GPP TS 25.214, 6A.2).
double blockBits(double ecio)
{
    return std::clamp(7168.0 + 900.0 * (ecio + 10.0), 461.0, 14411.0);
}

/// A whole number near the mean.
double drawn(double mean, Random& random)
{
    return std::max(0.0, std::floor(mean + std::sqrt(mean) * random.normal() + random.uniform()));
}

} // namespace

void UmtsTraffic::begin(Kind newKind, Random& random)
{
    kind = newKind;
    carriers = random.chance(kDualCarrier) ? 2 : 1;
    processes = {};
    // Signalling, and speech or the way back of the data; an interval of 40 and 20 ms.
    channels = {{{31, 25, 0, 0}, {static_cast<std::uint8_t>(isData() ? 24 : 1), 50, 0, 0}}};
}

void UmtsTraffic::transmit(Process& process, double blocks, double ecio, Random& random)
{
    const double sent = drawn(blocks, random);
    process.newTransmissions += sent;
    process.receivedBits += sent * std::floor(blockBits(ecio));
    process.blockErrors += std::min(sent, drawn(sent * kBlockErrorRate, random));
}

void UmtsTraffic::advance(double seconds, double ecio, Random& random)
{
    reportedTime = seconds;
    const double badness = std::clamp((-12.0 - ecio) / 4.0, 0.0, 1.0);
    for (Channel& channel : channels) {
        const double blocks = drawn(channel.blocksPerSecond * seconds, random);
        channel.received += blocks;
        channel.inError += std::min(blocks, random.chance(blocks * (0.008 + 0.1 * badness)) ? 1.0 : 0.0);
    }
    if (!isData())
        return;
    const double blocks = kSubFramesPerSecond * seconds * kScheduled / static_cast<double>(kProcesses);
    for (std::size_t carrier = 0; carrier < carriers; ++carrier)
        for (Process& process : processes[carrier])
            transmit(process, blocks, ecio, random);
}

void UmtsTraffic::writeHarq(MessageBatch& log) const
{
    using Layout = LogCode_0x4221;
    const Records lists[] = {Layout::primaryProcesses, Layout::secondaryProcesses(kProcesses)};
    PacketWriter packet =
        log.packet(0x4221, lists[carriers - 1].start + lists[carriers - 1].stride * kProcesses);
    packet.put(Layout::version, kHarqVersion);
    packet.put(Layout::subFrameCount, std::lround(reportedTime * kSubFramesPerSecond));
    packet.put(Layout::carriers, carriers == 2 ? kDualCarrierCode : kSingleCarrierCode);
    packet.put(Layout::primaryCount, kProcesses);
    packet.put(Layout::secondaryCount, carriers == 2 ? kProcesses : 0);
    for (std::size_t carrier = 0; carrier < carriers; ++carrier)
        for (std::size_t index = 0; index < kProcesses; ++index) {
            const Process& process = processes[carrier][index];
            PacketWriter entry = packet.record(lists[carrier], index);
            entry.put(Layout::Process::identity, static_cast<std::int64_t>(index));
            entry.put(Layout::Process::receivedBits, static_cast<std::int64_t>(process.receivedBits));
            entry.put(Layout::Process::newTransmissions, static_cast<std::int64_t>(process.newTransmissions));
            entry.put(Layout::Process::blockErrors, static_cast<std::int64_t>(process.blockErrors));
        }
}

void UmtsTraffic::writeBlockErrors(MessageBatch& log) const
{
    using Layout = LogCode_0x4116;
    PacketWriter packet =
        log.packet(0x4116, Layout::channels.start + Layout::channels.stride * channels.size());
    packet.put(Layout::channelCount, static_cast<std::int64_t>(channels.size()));
    packet.put(Layout::windowSize, kWindow);
    for (std::size_t index = 0; index < channels.size(); ++index) {
        const Channel& channel = channels[index];
        PacketWriter entry = packet.record(Layout::channels, index);
        entry.put(Layout::Channel::identity, channel.identity);
        entry.put(Layout::Channel::received, static_cast<std::int64_t>(channel.received));
        entry.put(Layout::Channel::inError, static_cast<std::int64_t>(channel.inError));
    }
}

} // namespace pelorus
