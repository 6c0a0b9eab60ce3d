#include "telephonyd/simulation/CdmaPackets.h"

#include "LogGenerator/C2K/LogCode_0x119C.h"
#include "LogGenerator/C2K/LogCode_0x119D.h"
#include "LogGenerator/C2K/LogCode_0x134F.h"
#include "telephonyd/simulation/Decibels.h"
#include "telephonyd/simulation/Units.h"

namespace pelorus {

namespace {

constexpr Field kPacketVersion = u8(13);
constexpr Field kSubpacketVersion = u8(1);
constexpr int kVersion = 1;

// What the searcher adds up: chips at a time, so many times, shifted right in steps of a quarter.
constexpr int kChips = 512;
constexpr int kTimes = 2;
constexpr int kShift = 5;
constexpr double kEnergyOfAll = 9.0 * kChips * kChips * kTimes / (1 << (2 * kShift - 3));

// Bytes of the subpackets, headers included.
constexpr std::size_t kStateSize = 8;
constexpr std::size_t kRadioSize = 16;
constexpr std::size_t kFingersSize = 56;
constexpr std::size_t kDemodulatorSize = 28;
constexpr std::size_t kSupplementSize = 16; // of another subpacket of 0x119D
constexpr unsigned kSupplement = 10;
constexpr std::size_t kSystemLength = 190;

constexpr int kChainOff = -128; // level of a chain that does not receive

/// Puts subpackets one behind the other into a packet that is long enough for them.
class Subpackets {
public:
    explicit Subpackets(PacketWriter packet) : whole(packet) { whole.put(kPacketVersion, kVersion); }

    PacketWriter add(unsigned identifier, std::size_t size)
    {
        PacketWriter subpacket = whole.record({.start = position, .stride = 0}, 0);
        subpacket.put(SubpacketLayout::identifier, identifier);
        subpacket.put(kSubpacketVersion, kVersion);
        subpacket.put(SubpacketLayout::size, static_cast<std::int64_t>(size));
        whole.put(SubpacketLayout::count, ++count);
        position += size;
        return subpacket;
    }

private:
    PacketWriter whole;
    std::size_t position = SubpacketLayout::start;
    int count = 0;
};

/// As the log has the level of a 1x receive chain.
int levelStep(double dBm)
{
    return rounded((dBm + 63.248) / 0.334);
}

void putRadio(PacketWriter radio, bool isTalking, const CdmaCarrier& carrier, double transmitLevel)
{
    using Radio = LogCode_0x119C::Radio;
    radio.put(Radio::bandClass0, kCdmaBandClass);
    radio.put(Radio::bandClass1, kCdmaBandClass);
    radio.put(Radio::channel0, kCdmaChannel);
    radio.put(Radio::channel1, kCdmaChannel);
    radio.put(Radio::receiveLevel0, levelStep(carrier.levels[0]));
    radio.put(Radio::receiveLevel1, isTalking ? levelStep(carrier.levels[1]) : kChainOff);
    radio.put(Radio::transmitLevel, rounded(10.0 * transmitLevel));
}

void putActiveSet(PacketWriter activeSet, std::uint32_t chains, const CdmaCarrier& carrier,
                  const PilotSet& pilots)
{
    using ActiveSet = LogCode_0x119C::ActiveSet;
    activeSet.put(ActiveSet::a, kChips);
    activeSet.put(ActiveSet::b, kTimes);
    activeSet.put(ActiveSet::c, kShift);
    activeSet.put(ActiveSet::pilotCount, static_cast<std::int64_t>(pilots.size()));
    activeSet.put(ActiveSet::k, static_cast<std::int64_t>(chains));
    activeSet.put(ActiveSet::referencePn, kCdmaSectors[pilots.reference()].pilot);
    for (std::size_t index = 0; index < pilots.size(); ++index) {
        const double strength = milliwatts(carrier.strengths[pilots[index]]);
        PacketWriter pilot = activeSet.record(ActiveSet::pilots(chains), index);
        pilot.put(ActiveSet::pn, kCdmaSectors[pilots[index]].pilot);
        // Noise adds up as well, one part in so many chips.
        pilot.put(ActiveSet::energy(chains), rounded((strength + 1.0 / kChips) * kEnergyOfAll));
    }
}

} // namespace

void writeCdmaState(MessageBatch& log, CdmaState state, const CdmaCarrier& carrier, const PilotSet& pilots,
                    double transmitLevel)
{
    using Layout = LogCode_0x119C;
    const bool isTalking = state == CdmaState::traffic;
    const std::uint32_t chains = isTalking ? 2 : 1;
    const Records records = Layout::ActiveSet::pilots(chains);
    const std::size_t activeSetSize = records.start + records.stride * pilots.size();
    Subpackets subpackets(
        log.packet(0x119C, SubpacketLayout::start + kStateSize + kRadioSize + activeSetSize + kFingersSize));
    subpackets.add(Layout::SystemState::identifier, kStateSize)
        .put(Layout::SystemState::deviceState, static_cast<std::int64_t>(state));
    putRadio(subpackets.add(Layout::Radio::identifier, kRadioSize), isTalking, carrier, transmitLevel);
    putActiveSet(subpackets.add(Layout::ActiveSet::identifier, activeSetSize), chains, carrier, pilots);
    subpackets.add(Layout::Fingers::identifier, kFingersSize);
}

void writeCdmaFrame(MessageBatch& log, bool isLost)
{
    using Demodulator = LogCode_0x119D::TrafficDemodulator;
    Subpackets subpackets(log.packet(0x119D, SubpacketLayout::start + kSupplementSize + kDemodulatorSize));
    subpackets.add(kSupplement, kSupplementSize);
    subpackets.add(Demodulator::identifier, kDemodulatorSize).put(Demodulator::frameError, isLost ? 1 : 0);
}

void writeCdmaSystem(MessageBatch& log, std::size_t sector)
{
    using Layout = LogCode_0x134F;
    const CdmaSector& system = kCdmaSectors[sector];
    PacketWriter packet = log.packet(0x134F, kSystemLength);
    packet.put(Layout::version, Layout::firstVersion);
    packet.put(Layout::roamingIndicator, system.roamingIndicator);
    packet.put(Layout::systemType, Layout::knownSystemType);
    packet.put(Layout::systemIdentifier, system.systemIdentifier);
    packet.put(Layout::networkIdentifier, system.networkIdentifier);
    packet.put(Layout::packetZone, system.packetZone);
    packet.put(Layout::protocolRevision, kCdmaProtocolRevision);
    packet.put(Layout::baseStation, system.baseStation);
}

} // namespace pelorus
