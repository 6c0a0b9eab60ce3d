#include "telephonyd/simulation/GsmHandset.h"

#include "telephonyd/simulation/Units.h"

namespace pelorus {

namespace {

using namespace std::chrono_literals;

constexpr std::chrono::milliseconds kSearchPeriod = 250ms; // while there is no cell
constexpr std::chrono::milliseconds kCellListPeriod = 30s;
constexpr std::chrono::milliseconds kSimPeriod = 30min;
constexpr double kGoodGsm = -95.0; // dBm

} // namespace

GsmHandset::GsmHandset(std::uint64_t seed)
    : random(seed), journey(kRoad, random), gsm(journey.position(), random), umts(journey.position(), random),
      subscriber(random)
{
    target = gsm.radio().best();
    registered.locationArea = kGsmCells[target].locationArea; // as the SIM remembers
    start(kSwitchOn);
}

void GsmHandset::step(MessageBatch& log)
{
    log.setTime(now);
    const Milliseconds end = now + period();
    repeatWhatIsDue(log);
    report(log);
    if (technology == Technology::umts)
        if (const auto cell = umts.target())
            enterUmts(log, *cell);
    decide();
    while (const auto event = signalling.run(log, end))
        perform(*event, log);
    live(end - now);
}

GsmHandset::Milliseconds GsmHandset::period() const
{
    if (technology == Technology::none)
        return kSearchPeriod;
    return technology == Technology::gsm ? gsm.period() : umts.period();
}

void GsmHandset::live(Milliseconds time)
{
    now += time;
    const double seconds = inSeconds(time);
    journey.advance(seconds, random);
    gsm.advance(journey, seconds, random);
    umts.advance(journey, seconds, random);
}

GsmHandset::Milliseconds GsmHandset::soon(double leastSeconds, double mostSeconds)
{
    return now + Milliseconds(static_cast<std::int64_t>(1000 * random.between(leastSeconds, mostSeconds)));
}

void GsmHandset::report(MessageBatch& log)
{
    if (technology == Technology::gsm)
        gsm.report(log, umts.radio(), random);
    else if (technology == Technology::umts)
        umts.report(log, gsm.radio(), random);
}

void GsmHandset::decide()
{
    if (signalling.isBusy() || (activity == Activity::idle && keepRegistered()))
        return;
    const auto doing = static_cast<std::size_t>(activity);
    const Procedures& does = procedures();
    const auto elsewhere = does.leaving[doing].empty() ? std::nullopt : otherTechnologyTarget();
    if (leaving.holds(elsewhere ? std::optional<std::size_t>(0) : std::nullopt, inSeconds(period()))) {
        target = *elsewhere;
        start(does.leaving[doing]);
    } else if (const auto cell = does.cellChange[doing].empty() ? std::nullopt : gsm.target()) {
        target = *cell;
        start(does.cellChange[doing]);
    } else if (now >= phaseEnds) {
        const Activity next = nextActivity[inGsm() ? 0 : 1];
        start(activity == Activity::idle ? does.beginning[static_cast<std::size_t>(next)]
                                         : does.ending[doing]);
    }
}

bool GsmHandset::keepRegistered()
{
    if (routingTechnology == Technology::none) {
        start(kGsmProcedures.locationUpdate);
        start(kAttach);
        start(kRegistrationEnds);
        return true;
    }
    const RegistrationArea here = area();
    const bool isOtherLocation = here.locationArea != registered.locationArea;
    if (isOtherLocation)
        start(procedures().locationUpdate);
    if (isOtherLocation || here.routingArea != registered.routingArea || technology != routingTechnology)
        start(procedures().routingAreaUpdate);
    return signalling.isBusy();
}

std::optional<std::size_t> GsmHandset::otherTechnologyTarget() const
{
    if (inGsm())
        return now >= nextSearch && umts.isGood() ? std::optional(umts.radio().best()) : std::nullopt;
    const std::size_t best = gsm.radio().best();
    return umts.isWornOut() && gsm.radio().average(best) > kGoodGsm ? std::optional(best) : std::nullopt;
}

void GsmHandset::perform(HandsetEvent event, MessageBatch& log)
{
    switch (event) {
    case HandsetEvent::gsmCellEntered:
        return enterGsm(log);
    case HandsetEvent::umtsCellEntered:
        return enterUmts(log, target);
    case HandsetEvent::signallingChannel:
        return gsm.writeSignallingChannel(log);
    case HandsetEvent::trafficChannel:
        return gsm.writeTrafficChannel(log);
    case HandsetEvent::callBegins:
        return begin(Activity::call);
    case HandsetEvent::dataBegins:
        return begin(Activity::data);
    case HandsetEvent::activityEnds:
        return end();
    case HandsetEvent::contextsChange:
        return subscriber.contexts(log, activity == Activity::data);
    case HandsetEvent::locationUpdated:
        registered.locationArea = area().locationArea;
        return writeServingNetwork(
            log, routingTechnology == Technology::none ? ServiceType::csOnly : ServiceType::csAndPs,
            registered);
    case HandsetEvent::routingUpdated:
        registered.routingArea = area().routingArea;
        routingTechnology = technology;
        return writeServingNetwork(log, ServiceType::csAndPs, registered);
    case HandsetEvent::registered:
        writeEquivalentNetworks(log);
        subscriber.contexts(log, false);
        phaseEnds = soon(8, 20);
        return;
    }
}

void GsmHandset::enterGsm(MessageBatch& log)
{
    if (technology == Technology::none)
        writeServingNetwork(log, ServiceType::limited, {});
    if (technology != Technology::gsm)
        nextSearch = soon(40, 70); // it does not come back at once
    technology = Technology::gsm;
    umts.release();
    gsm.setTalking(activity == Activity::call);
    gsm.enter(log, target);
    writeCells(log);
}

void GsmHandset::enterUmts(MessageBatch& log, std::size_t cell)
{
    technology = Technology::umts;
    umts.enter(log, cell);
    writeCells(log);
}

void GsmHandset::begin(Activity newActivity)
{
    activity = newActivity;
    phaseEnds = soon(20, 60);
    Activity& next = nextActivity[inGsm() ? 0 : 1];
    next = next == Activity::call ? Activity::data : Activity::call;
    if (inGsm())
        gsm.setTalking(activity == Activity::call);
    else
        umts.connect(activity == Activity::call ? UmtsTraffic::Kind::voice : UmtsTraffic::Kind::data, random);
}

void GsmHandset::end()
{
    activity = Activity::idle;
    phaseEnds = soon(30, 80);
    gsm.setTalking(false);
    umts.release();
}

void GsmHandset::writeCells(MessageBatch& log)
{
    if (inGsm())
        cellMonitor.writeInGsm(log, gsm.radio(), gsm.serving(), umts.radio(), random);
    else
        cellMonitor.writeInUmts(log, umts.radio(), umts.serving(), gsm.radio(), random);
    nextCellList = now + kCellListPeriod;
}

void GsmHandset::repeatWhatIsDue(MessageBatch& log)
{
    if (now >= nextSim) {
        subscriber.sim(log, registered.locationArea);
        nextSim = now + kSimPeriod;
    }
    if (technology != Technology::none && now >= nextCellList)
        writeCells(log);
}

} // namespace pelorus
