#include "telephonyd/simulation/IfxHandset.h"

#include "telephonyd/simulation/PacketList.h"
#include "telephonyd/simulation/Units.h"

#include <algorithm>

namespace pelorus {

namespace {

using namespace std::chrono_literals;

constexpr std::chrono::milliseconds kPeriod = 640ms;
constexpr std::chrono::milliseconds kSearch = 3s;
constexpr double kHysteresis = 4.0;         // dB
constexpr double kInterferenceMemory = 3.0; // seconds

} // namespace

IfxHandset::IfxHandset(std::uint64_t seed)
    : random(seed), journey(kRoad, random), gsm(journey.position(), random), umts(journey.position(), random),
      interference(random), activityEnds(kSearch)
{}

void IfxHandset::step(MessageBatch& log)
{
    changeActivity();
    if (activity != Activity::searching)
        changeCell();
    log.setTime(now);
    log.bare(packetList(display()));
    live();
}

IfxHandset::Milliseconds IfxHandset::soon(double leastSeconds, double mostSeconds)
{
    return now + Milliseconds(static_cast<std::int64_t>(1000 * random.between(leastSeconds, mostSeconds)));
}

void IfxHandset::changeActivity()
{
    if (now < activityEnds)
        return;
    switch (activity) {
    case Activity::searching:
        serving = gsm.best();
        activity = Activity::idle;
        activityEnds = soon(10, 30);
        return;
    case Activity::idle:
        activity = next;
        next = activity == Activity::call ? Activity::data : Activity::call;
        activityEnds = soon(15, 50);
        return;
    case Activity::call:
    case Activity::data:
        activity = Activity::idle;
        activityEnds = soon(20, 60);
        return;
    }
}

void IfxHandset::changeCell()
{
    const std::size_t best = gsm.best();
    const bool isBetter = gsm.average(best) > gsm.average(serving) + kHysteresis;
    if (cellChange.holds(isBetter ? std::optional(best) : std::nullopt, inSeconds(kPeriod))) {
        serving = best;
        cellChange.reset();
    }
}

std::shared_ptr<Dictionary> IfxHandset::display() const
{
    auto sections = makeDictionary();
    const auto add = [&sections](Label name, auto section) {
        if (section)
            sections->set(name, std::move(section));
    };
    if (activity == Activity::searching) {
        add("Radio Resource", ifxRadioResource("Cell Selection", false));
        return sections;
    }
    add("Serving Cell", ifxServingCell(gsm, serving));
    add("Neighbor Cells", ifxNeighbours(gsm, serving));
    switch (activity) {
    case Activity::call:
        add("Radio Resource", ifxRadioResource("Dedicated", true));
        add("Dedicated Channel", ifxDedicatedChannel(connection()));
        break;
    case Activity::data:
        add("Radio Resource", ifxRadioResource("Packet Transfer", true));
        add("Packet Transfer", ifxPacketTransfer(connection()));
        break;
    default:
        add("Radio Resource", ifxRadioResource("Idle", true));
        add("UMTS Cells", ifxUmtsCells(umts));
        break;
    }
    return sections;
}

IfxConnection IfxHandset::connection() const
{
    const Point site = kSites[kGsmCells[serving].site];
    const Point here = journey.position();
    const double level = gsm.average(serving);
    const double errors = (-88.0 - level) / 3.0 + 1.5 * interference.now();
    return {serving, level, std::clamp(rounded(errors), 0, 7), std::hypot(here.x - site.x, here.y - site.y)};
}

void IfxHandset::live()
{
    now += kPeriod;
    const double seconds = inSeconds(kPeriod);
    journey.advance(seconds, random);
    gsm.advance(journey, seconds, random);
    umts.advance(journey, seconds, random);
    interference.advance(Fading(seconds, kInterferenceMemory), random);
}

} // namespace pelorus
