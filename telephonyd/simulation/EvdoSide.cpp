#include "telephonyd/simulation/EvdoSide.h"

#include "telephonyd/simulation/Units.h"

#include <algorithm>

namespace pelorus {

namespace {

using namespace std::chrono_literals;

constexpr std::chrono::milliseconds kTick = 80ms;
constexpr std::chrono::milliseconds kIdlePeriod = 1280ms; // of reports
constexpr std::chrono::milliseconds kConnectedPeriod = 160ms;
constexpr std::uint64_t kReportsPerSummary = 4; // while connected
constexpr std::chrono::seconds kIdleCounters = 5s;
constexpr std::chrono::seconds kConnectedCounters = 1s;
constexpr std::chrono::milliseconds kBetweenMessages = 2ms;
constexpr std::chrono::milliseconds kOnAndOn = 0ms; // until something else begins

constexpr double kIdleHandoff = 2.5; // dB
constexpr double kServingChange = 1.5;
constexpr std::uint32_t kAccessTerminals = 0x1000000;

// Power, in dBm and dB: the open loop of band class 1, and what the network makes of it.
constexpr double kOpenLoop = -76.0;
constexpr double kCorrection = 1.0; // data take more than pilots
constexpr double kCorrectionDeviation = 3.0;
constexpr double kCorrectionMemory = 1.5; // seconds
constexpr double kLowestPower = -50.0;
constexpr double kHighestPower = 23.0;

} // namespace

std::span<const EvdoSide::Stage> EvdoSide::stagesOf(Course course)
{
    using State = EvdoState;
    using Session = EvdoSession;
    static constexpr Stage kOpening[] = {
        {State::inactive, Session::closed, 960ms},
        {State::acquisition, Session::closed, 640ms},
        {State::sync, Session::closed, 480ms},
        {State::idle, Session::closed, 160ms},
        {State::access, Session::ampSetup, 400ms},
        {State::connected, Session::ampSetup, 320ms},
        {State::connected, Session::terminalNegotiates, 480ms},
        {State::connected, Session::networkNegotiates, 400ms},
        {State::connected, Session::open, 960ms},
    };
    static constexpr Stage kIdle[] = {{State::idle, Session::open, kOnAndOn}};
    static constexpr Stage kConnecting[] = {{State::access, Session::open, 320ms}};
    static constexpr Stage kConnected[] = {{State::connected, Session::open, kOnAndOn}};
    static constexpr Stage kSuspended[] = {{State::inactive, Session::open, kOnAndOn}};
    static constexpr Stage kResuming[] = {{State::acquisition, Session::open, 640ms},
                                          {State::sync, Session::open, 480ms}};
    switch (course) {
    case Course::opening:
        return kOpening;
    case Course::idle:
        return kIdle;
    case Course::connecting:
        return kConnecting;
    case Course::connected:
        return kConnected;
    case Course::suspended:
        return kSuspended;
    case Course::resuming:
        return kResuming;
    case Course::off:
        break;
    }
    return {};
}

void EvdoSide::begin(Course next, Milliseconds now)
{
    course = next;
    stages = 0;
    stageEnds = now;
}

EvdoSide::Milliseconds EvdoSide::wakes(Milliseconds now) const
{
    const bool hasBegun = stages > 0;
    if (hasBegun && course == Course::idle)
        return std::max(nextReport, now + kTick);
    if ((hasBegun && course == Course::suspended) || course == Course::off)
        return Milliseconds::max();
    return now + kTick;
}

void EvdoSide::live(MessageBatch& log, const CdmaRadio& radio, Milliseconds now, Milliseconds time,
                    Random& random)
{
    if (course == Course::off)
        return;
    const CdmaCarrier& carrier = radio.evdo();
    power.advance(Fading(inSeconds(time), kCorrectionMemory), random);
    if (now >= stageEnds)
        nextStage(carrier, now, random);
    if (isOnAir())
        chooseServing(carrier, inSeconds(time));
    if (summary.state == EvdoState::idle && summary.session == EvdoSession::open &&
        kCdmaSectors[*summary.serving].colorCode != summary.colorCode)
        joinSubnet(random);
    if (isConnected()) {
        const double wanted =
            kOpenLoop - carrier.levels[0] + kCorrection + kCorrectionDeviation * power.now();
        summary.transmitLevel = std::clamp(wanted, kLowestPower, kHighestPower);
        link.advance(inSeconds(time), carrier.ratios[*summary.serving], kHighestPower - wanted, random);
    }
    report(log, carrier, now, random);
    reportCounters(log, now);
}

void EvdoSide::nextStage(const CdmaCarrier& carrier, Milliseconds now, Random& random)
{
    if (stages == stagesOf(course).size()) {
        if (stagesOf(course).back().lasts == kOnAndOn)
            return;
        begin(course == Course::connecting ? Course::connected : Course::idle, now);
    }
    const Stage& stage = stagesOf(course)[stages++];
    stageEnds = now + stage.lasts;
    summary.state = stage.state;
    summary.session = stage.session;
    hasChanged = true;
    switch (stage.state) {
    case EvdoState::inactive:
    case EvdoState::acquisition:
        pilots.clear();
        summary.serving.reset();
        break;
    case EvdoState::sync:
        summary.serving = carrier.best();
        pilots.reset(*summary.serving);
        break;
    case EvdoState::idle:
        pilots.reset(*summary.serving);
        break;
    case EvdoState::access:
        if (stage.session == EvdoSession::ampSetup)
            joinSubnet(random);
        break;
    case EvdoState::connected:
        break;
    }
}

void EvdoSide::joinSubnet(Random& random)
{
    summary.colorCode = kCdmaSectors[*summary.serving].colorCode;
    summary.accessTerminal = random.below(kAccessTerminals);
    hasChanged = true;
}

void EvdoSide::chooseServing(const CdmaCarrier& carrier, double seconds)
{
    const std::size_t serving = *summary.serving;
    if (isConnected()) {
        pilots.update(carrier, seconds);
        const std::size_t best = pilots.best(carrier);
        if (!pilots.contains(serving) || carrier.averages[best] > carrier.averages[serving] + kServingChange)
            summary.serving = best;
        return;
    }
    const std::size_t best = carrier.best();
    if (carrier.averages[best] > carrier.averages[serving] + kIdleHandoff) {
        summary.serving = best;
        pilots.reset(best);
    }
}

void EvdoSide::report(MessageBatch& log, const CdmaCarrier& carrier, Milliseconds now, Random& random)
{
    if (!hasChanged && (!isOnAir() || now < nextReport))
        return;
    nextReport = now + (isConnected() ? kConnectedPeriod : kIdlePeriod);
    if (hasChanged || !isConnected() || ++reports % kReportsPerSummary == 0) {
        writeEvdoSummary(log, carrier, summary);
        log.setTime(log.time() + kBetweenMessages);
    }
    hasChanged = false;
    writeEvdoPilots(log, carrier, pilots);
    log.setTime(log.time() + kBetweenMessages);
    writeEvdoFingers(log, carrier, pilots, random);
    log.setTime(log.time() + kBetweenMessages);
}

void EvdoSide::reportCounters(MessageBatch& log, Milliseconds now)
{
    const auto second = std::chrono::floor<std::chrono::seconds>(now);
    if (!isOnAir() || second < countersAt + (isConnected() ? kConnectedCounters : kIdleCounters))
        return;
    countersAt = second;
    link.write(log, static_cast<std::uint32_t>(second.count()));
    log.setTime(log.time() + kBetweenMessages);
}

} // namespace pelorus
