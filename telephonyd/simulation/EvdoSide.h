#pragma once

#include "telephonyd/simulation/EvdoLink.h"
#include "telephonyd/simulation/EvdoPackets.h"

#include <span>

namespace pelorus {

/// The EV-DO half of a CDMA2000 handset: it opens a session when it is switched on, is connected while data
/// flows, and makes room for 1x calls.
class EvdoSide {
public:
    using Milliseconds = std::chrono::milliseconds;

    explicit EvdoSide(Random& random) : power(random), link(random) {}

    void powerUp(Milliseconds now) { begin(Course::opening, now); }
    bool isIdle() const { return course == Course::idle; }
    void connect(Milliseconds now) { begin(Course::connecting, now); }
    void release(Milliseconds now) { begin(Course::idle, now); }
    /// Off the air, and back again.
    void suspend(Milliseconds now) { begin(Course::suspended, now); }
    void resume(Milliseconds now) { begin(Course::resuming, now); }

    /// What passes in `time` up to `now`.
    void live(MessageBatch& log, const CdmaRadio& radio, Milliseconds now, Milliseconds time, Random& random);
    /// When it has something to do again.
    Milliseconds wakes(Milliseconds now) const;

private:
    enum class Course : std::uint8_t { off, opening, idle, connecting, connected, suspended, resuming };
    struct Stage {
        EvdoState state;
        EvdoSession session;
        Milliseconds lasts;
    };
    static std::span<const Stage> stagesOf(Course course);

    void begin(Course next, Milliseconds now);
    void nextStage(const CdmaCarrier& carrier, Milliseconds now, Random& random);
    void chooseServing(const CdmaCarrier& carrier, double seconds);
    void joinSubnet(Random& random);
    bool isOnAir() const { return pilots.size() > 0; }
    bool isConnected() const { return summary.state == EvdoState::connected; }
    void report(MessageBatch& log, const CdmaCarrier& carrier, Milliseconds now, Random& random);
    void reportCounters(MessageBatch& log, Milliseconds now);

    Drift power; // what the network makes of the handset's own idea of its power
    EvdoLink link;
    EvdoSummary summary;
    PilotSet pilots{{-7.0, -9.0}};
    Course course = Course::off;
    std::size_t stages = 0; // of the course, that have begun
    Milliseconds stageEnds{};
    Milliseconds nextReport{};
    std::chrono::seconds countersAt{}; // when they were reported last
    std::uint64_t reports = 0;
    bool hasChanged = false; // since the last report
};

} // namespace pelorus
