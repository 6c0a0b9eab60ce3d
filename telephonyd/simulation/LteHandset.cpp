#include "telephonyd/simulation/LteHandset.h"

namespace pelorus {

namespace {

using namespace std::chrono_literals;
using Milliseconds = std::chrono::milliseconds;

constexpr Milliseconds kDrxCycle = 320ms;
constexpr Milliseconds kConnectedPeriod = 40ms;
constexpr Milliseconds kBetweenMessages = 2ms; // of one measurement
constexpr double kIdleGain = 0.12;             // of new measurements in the averages
constexpr double kConnectedGain = 0.13;        // filterCoefficient fc4
constexpr double kTreselection = 2.0;          // seconds
constexpr double kHandoverTime = 0.32;
constexpr Milliseconds kCellListPeriod = 30s;
constexpr Milliseconds kSearchPeriod = 60s; // of other technologies
constexpr Milliseconds kSimPeriod = 30min;
constexpr std::uint64_t kCyclesPerOtherCarrier = 32;
constexpr std::size_t kMostNeighbours = 6;
constexpr std::size_t kMostMeasured = 8;
constexpr std::size_t kMostDetected = 3;
constexpr double kSearchBelow = 22.0; // Srxlev; SNonIntraSearch of what the cells broadcast

double inSeconds(Milliseconds time)
{
    return std::chrono::duration<double>(time).count();
}

} // namespace

LteHandset::LteHandset(std::uint64_t seed)
    : random(seed), journey(kRoad, random), radio(journey.position(), random), server(random),
      frequencyError(random), reselection(kTreselection), handover(kHandoverTime)
{}

void LteHandset::step(MessageBatch& log)
{
    log.setTime(now);
    if (!isOn)
        switchOn(log);
    else if (connected)
        talk(log);
    else
        camp(log);
}

LteHandset::Milliseconds LteHandset::soon(double leastSeconds, double mostSeconds)
{
    return now + Milliseconds(static_cast<std::int64_t>(1000 * random.between(leastSeconds, mostSeconds)));
}

void LteHandset::switchOn(MessageBatch& log)
{
    isOn = true;
    for (std::size_t cell = 1; cell < kLteCellCount; ++cell)
        if (radio[cell].averageRsrp > radio[serving].averageRsrp)
            serving = cell;
    surroundings.search(journey.position(), random);
    server.sim(log, serving);
    enterCell(log, serving);
    server.contexts(log, false);
    nextSearch = now + kSearchPeriod;
    nextSim = now + kSimPeriod;
    phaseEnds = soon(20, 60);
}

void LteHandset::live(Milliseconds time, double gain)
{
    now += time;
    journey.advance(inSeconds(time), random);
    radio.advance(journey, inSeconds(time), gain, random);
    frequencyError.advance(Fading(inSeconds(time), 120.0), random);
}

void LteHandset::camp(MessageBatch& log)
{
    live(kDrxCycle, kIdleGain);
    ++cycles;
    log.setTime(now);
    if (now >= nextSearch) {
        surroundings.search(journey.position(), random);
        nextSearch = now + kSearchPeriod;
    }
    updateMeasurementRules();
    writeServingMeasurement(log, radio, serving, rules);

    const auto target = reselectionTarget(radio, serving);
    const std::size_t carrier = kLteCells[serving].carrier;
    LteCellList neighbours(radio, serving, carrier, kLowestReportedRsrq);
    neighbours.limit(kMostNeighbours);
    if (!neighbours.empty()) {
        log.setTime(log.time() + kBetweenMessages);
        writeNeighbours(log, radio, serving, carrier, neighbours, 150.0 + 50.0 * frequencyError.now());
    }
    reportOtherCarrier(log, target);
    reportCandidate(log, target);
    log.setTime(log.time() + kBetweenMessages);
    if (reselection.holds(target, inSeconds(kDrxCycle)))
        enterCell(log, *target);
    if (now >= phaseEnds)
        setConnected(log, true);
    repeatWhatIsDue(log);
}

void LteHandset::talk(MessageBatch& log)
{
    live(kConnectedPeriod, kConnectedGain);
    log.setTime(now);
    const std::size_t carrier = kLteCells[serving].carrier;
    LteCellList measured(radio, serving, carrier, kLowestReportedRsrq);
    measured.limit(kMostMeasured);
    LteCellList detected(radio, serving, carrier, kLowestNoticedRsrq, kLowestReportedRsrq);
    detected.limit(kMostDetected);
    writeConnectedMeasurement(log, radio, serving, measured, detected, static_cast<int>(random.below(10)));

    log.setTime(log.time() + kBetweenMessages);
    const auto target = handoverTarget(radio, serving);
    if (handover.holds(target, inSeconds(kConnectedPeriod)))
        enterCell(log, *target);
    else if (now >= phaseEnds || (!target && isWornOut(radio, serving)))
        setConnected(log, false);
    repeatWhatIsDue(log);
}

void LteHandset::updateMeasurementRules()
{
    const double level = srxlev(radio[serving]);
    const int before = rules.rules;
    // The own carrier always, carriers of higher priority now and then whatever the level.
    rules.rules = 1 | 4 | (level <= kSearchBelow ? 2 : 0);
    rules.updated = rules.rules != before;
    rules.weakCycles = level < 0 ? rules.weakCycles + 1 : 0;
}

/// Measured now and then, and in every cycle while a cell there is about to be chosen.
void LteHandset::reportOtherCarrier(MessageBatch& log, std::optional<std::size_t> target)
{
    const std::size_t other = 1 - kLteCells[serving].carrier;
    static_assert(kLteCarrierCount == 2);
    const bool isChosen = target && kLteCells[*target].carrier == other;
    if (!isChosen && cycles % kCyclesPerOtherCarrier != 0)
        return;
    LteCellList neighbours(radio, serving, other, kLowestReportedRsrq);
    neighbours.limit(kMostNeighbours);
    if (neighbours.empty())
        return;
    log.setTime(log.time() + kBetweenMessages);
    writeNeighbours(log, radio, serving, other, neighbours, 150.0 + 50.0 * frequencyError.now());
}

void LteHandset::reportCandidate(MessageBatch& log, std::optional<std::size_t> target)
{
    const std::size_t own = kLteCells[serving].carrier;
    const auto add = [this](std::size_t cell) {
        const LteCarrier& carrier = kLteCarriers[kLteCells[cell].carrier];
        candidates.push_back({.technology = ReselectionCandidate::Technology::lte,
                              .priority = carrier.priority,
                              .channel = carrier.earfcn,
                              .identity = kLteCells[cell].physicalCellIdentity});
    };
    candidates.clear();
    if (target && kLteCells[*target].carrier != own)
        add(*target);
    else if (const LteCellList others(radio, serving, 1 - own, kLowestReportedRsrq); !others.empty())
        add(others.front());
    candidates.insert(candidates.end(), surroundings.candidates().begin(), surroundings.candidates().end());
    if (candidates.empty())
        return;
    log.setTime(log.time() + kBetweenMessages);
    turns.write(log, kLteCarriers[own].earfcn, kLteCells[serving].physicalCellIdentity, candidates);
}

void LteHandset::enterCell(MessageBatch& log, std::size_t cell)
{
    serving = cell;
    reselection.reset();
    handover.reset();
    rules = {};
    writeServingCell(log, serving);
    server.cellsAround(log, radio, surroundings, serving);
    nextCellList = now + kCellListPeriod;
}

void LteHandset::setConnected(MessageBatch& log, bool isConnected)
{
    connected = isConnected;
    reselection.reset();
    handover.reset();
    phaseEnds = connected ? soon(20, 60) : soon(45, 110);
    server.contexts(log, connected);
}

void LteHandset::repeatWhatIsDue(MessageBatch& log)
{
    if (now >= nextCellList) {
        server.cellsAround(log, radio, surroundings, serving);
        nextCellList = now + kCellListPeriod;
    }
    if (now >= nextSim) {
        server.sim(log, serving);
        nextSim = now + kSimPeriod;
    }
}

} // namespace pelorus
