#include "telephonyd/simulation/CdmaHandset.h"

#include "telephonyd/simulation/Units.h"

#include <algorithm>

namespace pelorus {

namespace {

using namespace std::chrono_literals;

constexpr std::chrono::milliseconds kShortestStep = 20ms; // what it logs takes its time

} // namespace

CdmaHandset::CdmaHandset(std::uint64_t seed)
    : random(seed), journey(kRoad, random), radio(journey.position(), random), cdma(random), evdo(random)
{
    cdma.powerUp(now);
}

void CdmaHandset::step(MessageBatch& log)
{
    log.setTime(now);
    changeActivity();
    evdo.live(log, radio, now, lastStep, random);
    cdma.live(log, radio, now, random);
    live();
}

CdmaHandset::Milliseconds CdmaHandset::soon(double leastSeconds, double mostSeconds)
{
    return now + Milliseconds(static_cast<std::int64_t>(1000 * random.between(leastSeconds, mostSeconds)));
}

void CdmaHandset::changeActivity()
{
    switch (activity) {
    case Activity::starting: // 1x first, which tells where EV-DO is
        if (!cdma.isIdle())
            return;
        evdo.powerUp(now);
        activity = Activity::idle;
        activityEnds = soon(12, 25);
        return;
    case Activity::idle:
        if (now >= activityEnds && cdma.isIdle() && evdo.isIdle())
            beginNext();
        return;
    case Activity::call:
        if (now < activityEnds)
            return;
        cdma.endCall(now);
        activity = Activity::returning;
        return;
    case Activity::returning:
        if (!cdma.isIdle())
            return;
        evdo.resume(now);
        activity = Activity::idle;
        activityEnds = soon(20, 50);
        return;
    case Activity::data:
        if (now < activityEnds)
            return;
        evdo.release(now);
        activity = Activity::idle;
        activityEnds = soon(20, 50);
        return;
    }
}

void CdmaHandset::beginNext()
{
    activity = next;
    if (activity == Activity::data) {
        evdo.connect(now);
        activityEnds = soon(25, 70);
        next = Activity::call;
        return;
    }
    evdo.suspend(now);
    cdma.beginCall(now);
    activityEnds = soon(20, 60);
    next = Activity::data;
}

void CdmaHandset::live()
{
    Milliseconds until = std::min(cdma.wakes(now), evdo.wakes(now));
    if (activityEnds > now)
        until = std::min(until, std::max(activityEnds, now + CdmaSide::kTick));
    until = std::max(until, now + kShortestStep);
    lastStep = until - now;
    now = until;
    journey.advance(inSeconds(lastStep), random);
    radio.advance(journey, inSeconds(lastStep), random);
}

} // namespace pelorus
