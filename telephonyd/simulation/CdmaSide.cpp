#include "telephonyd/simulation/CdmaSide.h"

#include "telephonyd/simulation/Decibels.h"
#include "telephonyd/simulation/Units.h"

#include <algorithm>

namespace pelorus {

namespace {

using namespace std::chrono_literals;

constexpr std::chrono::milliseconds kFrame = 20ms;
constexpr int kFramesPerTick = CdmaSide::kTick / kFrame;
constexpr std::uint64_t kTicksPerState = 5;
constexpr std::chrono::milliseconds kBetweenMessages = 2ms;
constexpr std::chrono::milliseconds kSystemPeriod = 30s;
constexpr double kIdleHandoff = 2.5; // dB

// Power, in dBm and dB. The handset sends the louder the less it receives (open loop, mean output power of
// band class 0), the network corrects that.
constexpr double kOpenLoop = -73.0;
constexpr double kCorrection = -3.0;
constexpr double kCorrectionDeviation = 3.0;
constexpr double kCorrectionMemory = 1.5; // seconds
constexpr double kLowestPower = -50.0;
constexpr double kHighestPower = 23.5;
constexpr double kPowerOff = -60.0;

// Frames: the outer loop holds one error in a hundred or so as long as there is power for it.
constexpr double kUsualErrorRate = 0.008;
constexpr double kNeededStrength = -5.0; // dB, of all pilots together
constexpr double kStrengthPerDecade = 4.0;
constexpr double kHighestErrorRate = 0.4;

} // namespace

std::span<const CdmaSide::Stage> CdmaSide::stagesOf(Course course)
{
    static constexpr Stage kSearch[] = {{CdmaState::powerUp, 240ms},
                                        {CdmaState::initial, 160ms},
                                        {CdmaState::acquisition, 480ms},
                                        {CdmaState::sync, 320ms},
                                        {CdmaState::slew, 80ms}};
    // A slot cycle of 1.28 s (index 0).
    static constexpr Stage kSlotCycle[] = {
        {CdmaState::paging, 160ms}, {CdmaState::sleep, 1040ms}, {CdmaState::unslew, 80ms}};
    static constexpr Stage kOrigination[] = {{CdmaState::unslew, 80ms}, {CdmaState::paging, 480ms}};
    switch (course) {
    case Course::searching:
        return kSearch;
    case Course::idle:
        return kSlotCycle;
    case Course::originating:
        return kOrigination;
    default:
        return {};
    }
}

void CdmaSide::begin(Course next, Milliseconds now)
{
    // A handset that comes from a call searches as well, but it is up already.
    stages = next == Course::searching && course != Course::off ? 1 : 0;
    course = next;
    stageEnds = now;
    ticks = 0;
    if (course == Course::searching) {
        pilots.clear();
        hasService = false;
    }
}

void CdmaSide::beginCall(Milliseconds now)
{
    constexpr std::size_t asleep = 2; // stages of a slot cycle
    const bool isAwake = stages != asleep;
    begin(Course::originating, now);
    stages = isAwake ? 1 : 0;
}

CdmaSide::Milliseconds CdmaSide::wakes(Milliseconds now) const
{
    const bool isAsleep = course == Course::idle && stageEnds > now;
    return isAsleep ? stageEnds : now + kTick;
}

void CdmaSide::live(MessageBatch& log, const CdmaRadio& radio, Milliseconds now, Random& random)
{
    power.advance(Fading(inSeconds(kTick), kCorrectionMemory), random);
    if (course == Course::talking)
        return talk(log, radio, now, random);
    if (course != Course::off && now >= stageEnds)
        nextStage(log, radio, now);
}

void CdmaSide::nextStage(MessageBatch& log, const CdmaRadio& radio, Milliseconds now)
{
    if (stages == stagesOf(course).size())
        endCourse(now);
    if (course == Course::talking)
        return;
    const Stage& stage = stagesOf(course)[stages++];
    stageEnds = now + stage.lasts;
    if (stage.state == CdmaState::sync)
        pilots.reset(radio.cdma().best());
    if (stage.state == CdmaState::paging)
        lookAround(log, radio, now);
    writeCdmaState(log, stage.state, radio.cdma(), pilots, kPowerOff);
    log.setTime(log.time() + kBetweenMessages);
}

void CdmaSide::endCourse(Milliseconds now)
{
    begin(course == Course::originating ? Course::talking : Course::idle, now);
}

void CdmaSide::lookAround(MessageBatch& log, const CdmaRadio& radio, Milliseconds now)
{
    const auto& averages = radio.cdma().averages;
    const std::size_t best = radio.cdma().best();
    const bool moves = averages[best] > averages[pilots.reference()] + kIdleHandoff;
    if (moves)
        pilots.reset(best);
    if (hasService && !moves && now < nextSystem)
        return;
    hasService = true;
    nextSystem = now + kSystemPeriod;
    writeCdmaSystem(log, pilots.reference());
    log.setTime(log.time() + kBetweenMessages);
}

double CdmaSide::frameErrorRate(const CdmaCarrier& carrier) const
{
    double together = 0;
    for (std::size_t index = 0; index < pilots.size(); ++index)
        together += milliwatts(carrier.strengths[pilots[index]]);
    const double missing = kNeededStrength - decibels(together);
    return std::clamp(kUsualErrorRate * std::pow(10.0, missing / kStrengthPerDecade), kUsualErrorRate,
                      kHighestErrorRate);
}

void CdmaSide::talk(MessageBatch& log, const CdmaRadio& radio, Milliseconds now, Random& random)
{
    const CdmaCarrier& carrier = radio.cdma();
    const std::size_t reference = pilots.reference();
    pilots.update(carrier, inSeconds(kTick));
    if (pilots.reference() != reference) { // the network says where it is now
        writeCdmaSystem(log, pilots.reference());
        log.setTime(log.time() + kBetweenMessages);
    }
    if (ticks++ % kTicksPerState == 0) {
        const double level = kOpenLoop - carrier.levels[0] + kCorrection + kCorrectionDeviation * power.now();
        writeCdmaState(log, CdmaState::traffic, carrier, pilots,
                       std::clamp(level, kLowestPower, kHighestPower));
    }
    const double errorRate = frameErrorRate(carrier);
    for (int frame = 0; frame < kFramesPerTick; ++frame) {
        log.setTime(std::max(log.time(), std::chrono::nanoseconds(now + frame * kFrame)));
        writeCdmaFrame(log, random.chance(errorRate));
    }
}

} // namespace pelorus
