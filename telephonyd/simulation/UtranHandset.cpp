#include "telephonyd/simulation/UtranHandset.h"

#include "LogGenerator/Osprey/CellMonitorKeys.h"
#include "telephonyd/simulation/Units.h"

namespace pelorus {

namespace {

using namespace std::chrono_literals;

constexpr std::chrono::milliseconds kIdlePeriod = 320ms; // half a DRX cycle
constexpr std::chrono::milliseconds kConnectedPeriod = 40ms;
constexpr std::chrono::milliseconds kBetweenMessages = 2ms; // of one report
constexpr std::chrono::milliseconds kCellListPeriod = 30s;
constexpr std::chrono::milliseconds kSimPeriod = 30min;
constexpr std::uint64_t kConnectedPerGsm = 12; // reports
constexpr double kHysteresis = 3.0;            // dB

using namespace CellMonitor;
constexpr std::string_view kServingKeys[] = {kMCC, kMNC, kLAC, kCellId, kBandInfo, kUARFCN, kSCN};
constexpr MonitoredCellKind kServingKind{kUTRAN2, true, kServingKeys};
constexpr std::string_view kNeighbourKeys[] = {kUARFCN, kSCN, kRSCP};
constexpr MonitoredCellKind kNeighbourKind{kUTRAN2, false, kNeighbourKeys};
constexpr std::string_view kGsmKeys[] = {kARFCN, kRSSI};
constexpr MonitoredCellKind kGsmKind{kGSM, false, kGsmKeys};
constexpr std::size_t kMostGsmNeighbours = 4;

} // namespace

UtranHandset::UtranHandset(std::uint64_t seed)
    : random(seed), journey(kRoad, random), radio(journey.position(), random),
      gsm(journey.position(), random), subscriber(random)
{}

void UtranHandset::step(MessageBatch& log)
{
    log.setTime(now);
    if (!isOn)
        switchOn(log);
    report(log);
    changeCell(log);
    if (now >= modeEnds)
        changeMode(log);
    repeatWhatIsDue(log);
    live(period());
}

UtranHandset::Milliseconds UtranHandset::period() const
{
    return mode == UtranMode::cellDch ? kConnectedPeriod : kIdlePeriod;
}

void UtranHandset::live(Milliseconds time)
{
    now += time;
    journey.advance(inSeconds(time), random);
    radio.advance(journey, inSeconds(time), random);
    gsm.advance(journey, inSeconds(time), random);
}

UtranHandset::Milliseconds UtranHandset::soon(double leastSeconds, double mostSeconds)
{
    return now + Milliseconds(static_cast<std::int64_t>(1000 * random.between(leastSeconds, mostSeconds)));
}

void UtranHandset::switchOn(MessageBatch& log)
{
    isOn = true;
    serving = radio.best();
    subscriber.sim(log, kUtranCells[serving].locationArea);
    nextSim = now + kSimPeriod;
    enterMode(log, UtranMode::disconnected);
    enterCell(log, serving);
    subscriber.contexts(log, false);
    modeEnds = soon(10, 30);
}

void UtranHandset::report(MessageBatch& log)
{
    const bool isDedicated = mode == UtranMode::cellDch;
    ++reports;
    writeUtranNeighbours(log, radio, serving, isDedicated);
    log.setTime(log.time() + kBetweenMessages);
    if (isDedicated) {
        traffic.advance(radio.interferenceRatio(serving), random);
        writeTransportChannels(log, traffic);
    }
    if (!isDedicated || reports % kConnectedPerGsm == 0)
        writeUtranGsmNeighbours(log, gsm);
}

void UtranHandset::changeCell(MessageBatch& log)
{
    const std::size_t best = radio.best();
    const bool isBetter = radio.rscp(best) > radio.rscp(serving) + kHysteresis;
    if (!cellChange.holds(isBetter ? std::optional(best) : std::nullopt, inSeconds(period())))
        return;
    log.setTime(log.time() + kBetweenMessages);
    enterCell(log, best);
}

void UtranHandset::enterCell(MessageBatch& log, std::size_t cell)
{
    serving = cell;
    cellChange.reset();
    writeUtranServingCell(log, cell);
    writeCells(log);
}

void UtranHandset::enterMode(MessageBatch& log, UtranMode next)
{
    mode = next;
    cellChange.reset();
    log.setTime(log.time() + kBetweenMessages);
    writeUtranMode(log, mode);
}

void UtranHandset::changeMode(MessageBatch& log)
{
    switch (mode) {
    case UtranMode::disconnected:
        course = Course::rising;
        isData = !isData;
        enterMode(log, UtranMode::connecting);
        modeEnds = now + kIdlePeriod;
        return;
    case UtranMode::connecting:
        enterMode(log, UtranMode::cellFach);
        modeEnds = now + kIdlePeriod;
        return;
    case UtranMode::cellFach:
        return leaveCommonChannel(log);
    case UtranMode::cellDch:
        // Data may come again, so its channels are taken away bit by bit; after a call all at once.
        course = Course::falling;
        enterMode(log, isData ? UtranMode::cellFach : UtranMode::disconnected);
        modeEnds = isData ? soon(3, 6) : soon(30, 80);
        return;
    case UtranMode::cellPch:
    case UtranMode::uraPch:
        course = Course::releasing;
        enterMode(log, UtranMode::cellFach);
        modeEnds = now + kIdlePeriod;
        return;
    }
}

void UtranHandset::leaveCommonChannel(MessageBatch& log)
{
    switch (course) {
    case Course::rising:
        traffic.begin(isData);
        enterMode(log, UtranMode::cellDch);
        modeEnds = soon(20, 60);
        break;
    case Course::falling:
        enterMode(log, random.chance(0.5) ? UtranMode::cellPch : UtranMode::uraPch);
        modeEnds = soon(8, 16);
        return;
    case Course::releasing:
        enterMode(log, UtranMode::disconnected);
        modeEnds = soon(30, 80);
        break;
    }
    if (isData)
        subscriber.contexts(log, course == Course::rising);
}

void UtranHandset::writeCells(MessageBatch& log)
{
    const UtranCell& here = kUtranCells[serving];
    cellList.clear();
    cellList.add(kServingKind, {1, 1, here.locationArea, here.cellIdentity, kUtranBand, here.uarfcn,
                                here.parameterIdentity});
    for (std::size_t cell = 0; cell < kUtranCellCount; ++cell)
        if (cell != serving && radio.isDetected(cell))
            cellList.add(kNeighbourKind, {kUtranCells[cell].uarfcn, kUtranCells[cell].parameterIdentity,
                                          std::lround(radio.rscp(cell))});
    for (const std::size_t cell : gsm.neighbours(kNoGsmCell, kMostGsmNeighbours))
        cellList.add(kGsmKind, {kGsmCells[cell].arfcn, std::lround(gsm.average(cell) / 2)});
    cellList.write(log);
    nextCellList = now + kCellListPeriod;
}

void UtranHandset::repeatWhatIsDue(MessageBatch& log)
{
    if (now >= nextCellList)
        writeCells(log);
    if (now >= nextSim) {
        subscriber.sim(log, kUtranCells[serving].locationArea);
        nextSim = now + kSimPeriod;
    }
}

} // namespace pelorus
