#include "telephonyd/simulation/EvdoPackets.h"

#include "LogGenerator/C2K/LogCode_0x108A.h"
#include "LogGenerator/C2K/LogCode_0x1183.h"
#include "LogGenerator/C2K/LogCode_0x12B6.h"
#include "telephonyd/simulation/Decibels.h"
#include "telephonyd/simulation/RankedCells.h"
#include "telephonyd/simulation/Units.h"

namespace pelorus {

namespace {

constexpr int kNoPilot = 0xFFFF;
constexpr double kUnit = 512.0; // of ratios
constexpr std::size_t kFingers = 6;
constexpr std::size_t kPaths = 3; // of a sector, at most
/// What the paths of a sector have of its energy.
constexpr std::array<double, kPaths> kPathLoss{-1.6, -6.0, -10.5}; // dB
constexpr double kPathFading = 1.5;
constexpr double kLowestRatio = -16.0; // dB, where a finger loses its path

/// Something is left of the weakest: nothing would be minus infinity.
int ratio(double dB)
{
    return std::max(1, rounded(kUnit * milliwatts(dB)));
}

} // namespace

void writeEvdoSummary(MessageBatch& log, const CdmaCarrier& carrier, const EvdoSummary& summary)
{
    using Layout = LogCode_0x1183;
    PacketWriter packet = log.packet(0x1183, Layout::length);
    packet.put(Layout::channel, kEvdoChannel);
    packet.put(Layout::bandClass, kEvdoBandClass);
    packet.put(Layout::receiveLevel0, rounded(carrier.levels[0]));
    packet.put(Layout::receiveLevel1, rounded(carrier.levels[1]));
    packet.put(Layout::transmitLevel, rounded(summary.transmitLevel));
    packet.put(Layout::servingPilot, summary.serving ? kCdmaSectors[*summary.serving].pilot : kNoPilot);
    packet.put(Layout::deviceState, static_cast<std::int64_t>(summary.state));
    packet.put(Layout::sessionState, static_cast<std::int64_t>(summary.session));
    packet.put(Layout::accessTerminal, summary.accessTerminal);
    packet.put(Layout::colorCode, summary.colorCode);
}

void writeEvdoPilots(MessageBatch& log, const CdmaCarrier& carrier, const PilotSet& pilots)
{
    using Layout = LogCode_0x12B6;
    PacketWriter packet = log.packet(0x12B6, Layout::minimumLength + Layout::pilots.stride * pilots.size());
    packet.put(Layout::pilotCount, static_cast<std::int64_t>(pilots.size()));
    for (std::size_t index = 0; index < pilots.size(); ++index) {
        PacketWriter pilot = packet.record(Layout::pilots, index);
        pilot.put(Layout::Pilot::pn, kCdmaSectors[pilots[index]].pilot);
        pilot.put(Layout::Pilot::strength, ratio(carrier.strengths[pilots[index]]));
    }
}

void writeEvdoFingers(MessageBatch& log, const CdmaCarrier& carrier, const PilotSet& pilots, Random& random)
{
    using Layout = LogCode_0x108A;
    constexpr std::size_t capacity = PilotSet::kMost * kPaths;
    RankedCells<capacity> paths;
    std::array<double, capacity> ratios{};
    for (std::size_t path = 0; path < pilots.size() * kPaths; ++path) {
        ratios[path] =
            carrier.ratios[pilots[path / kPaths]] + kPathLoss[path % kPaths] + kPathFading * random.normal();
        if (ratios[path] > kLowestRatio)
            paths.add(path, ratios[path]);
    }
    paths.limit(kFingers);

    PacketWriter packet = log.packet(0x108A, Layout::minimumLength + Layout::fingers.stride * kFingers);
    packet.put(Layout::fingerCount, kFingers);
    for (std::size_t index = 0; index < kFingers; ++index) {
        const bool isLocked = index < paths.size();
        const std::size_t path = isLocked ? paths.begin()[index] : 0;
        PacketWriter finger = packet.record(Layout::fingers, index);
        finger.put(Layout::Finger::pn, isLocked ? kCdmaSectors[pilots[path / kPaths]].pilot : kNoPilot);
        finger.put(Layout::Finger::strength, isLocked ? ratio(ratios[path]) : 0);
    }
}

} // namespace pelorus
