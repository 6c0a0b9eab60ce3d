#include "telephonyd/simulation/UmtsSide.h"

#include "telephonyd/simulation/GsmPackets.h"
#include "telephonyd/simulation/Units.h"

namespace pelorus {

namespace {

using namespace std::chrono_literals;

constexpr std::chrono::milliseconds kIdlePeriod = 320ms; // half a DRX cycle
constexpr std::chrono::milliseconds kConnectedPeriod = 40ms;
constexpr std::chrono::milliseconds kBetweenMessages = 2ms; // of one report
// Reports
constexpr std::uint64_t kIdlePerRanking = 2;
constexpr std::uint64_t kConnectedPerCellSet = 2;
constexpr std::uint64_t kConnectedPerBlockErrors = 12;
constexpr std::size_t kMostRanked = 6;

constexpr double kReselectionHysteresis = 4.0; // dB
constexpr double kWornOut = -103.0;            // RSCP in dBm
constexpr double kGood = -98.0;
constexpr double kGoodEcio = -13.0; // dB

} // namespace

RegistrationArea UmtsSide::area() const
{
    return {kUmtsCells[servingCell].locationArea, kUmtsCells[servingCell].routingArea};
}

void UmtsSide::enter(MessageBatch& log, std::size_t cell)
{
    servingCell = cell;
    reselection.reset();
    if (!connected)
        activeSet.reset(cell);
    writeUmtsServingCell(log, cell);
}

void UmtsSide::connect(UmtsTraffic::Kind kind, Random& random)
{
    connected = true;
    reports = 0;
    activeSet.reset(servingCell);
    traffic.begin(kind, random);
}

void UmtsSide::release()
{
    connected = false;
    activeSet.reset(servingCell);
}

UmtsSide::Milliseconds UmtsSide::period() const
{
    return connected ? kConnectedPeriod : kIdlePeriod;
}

void UmtsSide::report(MessageBatch& log, const GsmRadio& gsm, Random& random)
{
    ++reports;
    if (connected)
        reportConnected(log, random);
    else
        reportIdle(log, gsm);
}

void UmtsSide::reportIdle(MessageBatch& log, const GsmRadio& gsm)
{
    writeUmtsCellSet(log, receiver, activeSet);
    log.setTime(log.time() + kBetweenMessages);
    // Both kinds stand at the same place of the record: they go by themselves, one after the other.
    if (reports % kIdlePerRanking == 0)
        writeRankedUmtsCells(log, receiver, servingCell);
    else
        writeRankedGsmCells(log, gsm, gsm.neighbours(kNoGsmCell, kMostRanked));
}

void UmtsSide::reportConnected(MessageBatch& log, Random& random)
{
    const UmtsMeasurement& best = receiver[activeSet.best(receiver)];
    traffic.advance(inSeconds(kConnectedPeriod), best.averageEcio, random);
    writeTransmitPower(log, best.averageRscp, random);
    log.setTime(log.time() + kBetweenMessages);
    if (reports % kConnectedPerCellSet == 1)
        writeUmtsCellSet(log, receiver, activeSet);
    if (traffic.isData())
        traffic.writeHarq(log);
    if (reports % kConnectedPerBlockErrors == 0)
        traffic.writeBlockErrors(log);
}

std::optional<std::size_t> UmtsSide::target()
{
    return connected ? followActiveSet() : reselectionTarget();
}

std::optional<std::size_t> UmtsSide::reselectionTarget()
{
    const std::size_t best = receiver.best();
    const bool isBetter =
        receiver[best].averageRscp > receiver[servingCell].averageRscp + kReselectionHysteresis;
    const auto target = isBetter ? std::optional(best) : std::nullopt;
    return reselection.holds(target, inSeconds(kIdlePeriod)) ? target : std::nullopt;
}

std::optional<std::size_t> UmtsSide::followActiveSet()
{
    activeSet.update(receiver, inSeconds(kConnectedPeriod));
    if (activeSet.contains(servingCell))
        return std::nullopt;
    return activeSet.best(receiver);
}

bool UmtsSide::isWornOut() const
{
    return receiver[receiver.best()].averageRscp < kWornOut;
}

bool UmtsSide::isGood() const
{
    const UmtsMeasurement& best = receiver[receiver.best()];
    return best.averageRscp > kGood && best.averageEcio > kGoodEcio;
}

} // namespace pelorus
