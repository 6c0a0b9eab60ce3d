#include "telephonyd/simulation/GsmSide.h"

#include "telephonyd/simulation/UmtsPackets.h"
#include "telephonyd/simulation/Units.h"

#include <algorithm>

namespace pelorus {

namespace {

using namespace std::chrono_literals;

constexpr std::chrono::milliseconds kIdlePeriod = 235ms;     // a 51-multiframe
constexpr std::chrono::milliseconds kDedicatedPeriod = 60ms; // half a 26-multiframe
constexpr std::chrono::milliseconds kBetweenMessages = 2ms;  // of one report
// Reports
constexpr std::uint64_t kIdlePerRanking = 4;
constexpr std::uint64_t kIdlePerIdentities = 20;
constexpr std::uint64_t kDedicatedPerBlock = 8; // of the slow associated channel
constexpr std::uint64_t kDedicatedPerIdentities = 80;
constexpr std::size_t kMostNeighbours = 6;

constexpr double kTurnsPerSecond = 0.6;     // between talking and listening
constexpr double kInterferenceMemory = 3.0; // seconds
constexpr double kHysteresis = 4.0;         // dB

} // namespace

void GsmSide::advance(const Journey& journey, double seconds, Random& random)
{
    receiver.advance(journey, seconds, random);
    interference.advance(Fading(seconds, kInterferenceMemory), random);
    if (random.chance(kTurnsPerSecond * seconds))
        silent = !silent;
}

RegistrationArea GsmSide::area() const
{
    return {kGsmCells[servingCell].locationArea, kGsmCells[servingCell].routingArea};
}

void GsmSide::enter(MessageBatch& log, std::size_t cell)
{
    servingCell = cell;
    change.reset();
    writeGsmServingCell(log, cell);
    writeStationIdentities(log, receiver.neighbours(cell, kMostNeighbours));
}

void GsmSide::writeSignallingChannel(MessageBatch& log) const
{
    writeDedicatedChannel(log, kGsmCells[servingCell].arfcn);
}

void GsmSide::writeTrafficChannel(MessageBatch& log) const
{
    writeDedicatedChannel(log, kGsmCells[servingCell].hoppingChannels.front());
    writeHopping(log, servingCell);
}

void GsmSide::setTalking(bool isTalking)
{
    talking = isTalking;
    reports = 0;
    change.reset();
}

GsmSide::Milliseconds GsmSide::period() const
{
    return talking ? kDedicatedPeriod : kIdlePeriod;
}

void GsmSide::report(MessageBatch& log, const UmtsRadio& umts, Random& random)
{
    ++reports;
    if (talking)
        reportDedicated(log, random);
    else
        reportIdle(log, umts);
}

void GsmSide::reportIdle(MessageBatch& log, const UmtsRadio& umts)
{
    const RankedGsmCells neighbours = receiver.neighbours(servingCell, kMostNeighbours);
    writeGsmIdleMeasurement(log, receiver, servingCell, neighbours);
    log.setTime(log.time() + kBetweenMessages);
    if (reports % kIdlePerRanking == 1)
        writeRankedGsmCells(log, receiver, receiver.neighbours(kNoGsmCell, kMostNeighbours));
    else if (reports % kIdlePerRanking == 3)
        writeRankedUmtsCells(log, umts, kNoUmtsCell);
    if (reports % kIdlePerIdentities == 0)
        writeStationIdentities(log, neighbours);
}

void GsmSide::reportDedicated(MessageBatch& log, Random& random)
{
    const RankedGsmCells neighbours = receiver.neighbours(servingCell, kMostNeighbours);
    writeGsmDedicatedMeasurement(log, receiver, servingCell, quality(random), neighbours);
    log.setTime(log.time() + kBetweenMessages);
    if (reports % kDedicatedPerBlock == 1)
        writeDiscontinuousTransmission(log, silent);
    if (reports % kDedicatedPerIdentities == 0)
        writeStationIdentities(log, neighbours);
}

GsmQuality GsmSide::quality(Random& random) const
{
    const double errors = (-92.0 - receiver.average(servingCell)) / 3.0 + 1.5 * interference.now();
    const auto onScale = [](double value) { return std::clamp(rounded(value), 0, 7); };
    return {onScale(errors), onScale(errors + 0.6 * random.normal())};
}

std::optional<std::size_t> GsmSide::target()
{
    const std::size_t best = receiver.best();
    const bool isBetter =
        reselectionCriterion(receiver, best) > reselectionCriterion(receiver, servingCell) + kHysteresis;
    const auto cell = isBetter ? std::optional(best) : std::nullopt;
    return change.holds(cell, inSeconds(period())) ? cell : std::nullopt;
}

} // namespace pelorus
