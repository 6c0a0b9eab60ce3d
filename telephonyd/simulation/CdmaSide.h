#pragma once

#include "telephonyd/simulation/CdmaPackets.h"

#include <span>

namespace pelorus {

/// The 1x half of a CDMA2000 handset: idle it sleeps between its paging slots and changes to a better sector
/// when it wakes; in a call it is in soft handoff, and loses a frame now and then.
class CdmaSide {
public:
    using Milliseconds = std::chrono::milliseconds;
    static constexpr Milliseconds kTick{80}; // four traffic frames

    explicit CdmaSide(Random& random) : power(random) {}

    void powerUp(Milliseconds now) { begin(Course::searching, now); }
    /// While it is neither searching nor in a call.
    bool isIdle() const { return course == Course::idle; }
    void beginCall(Milliseconds now);
    void endCall(Milliseconds now) { begin(Course::searching, now); }

    /// One tick.
    void live(MessageBatch& log, const CdmaRadio& radio, Milliseconds now, Random& random);
    /// When it has something to do again; the next tick when it is not asleep.
    Milliseconds wakes(Milliseconds now) const;

private:
    enum class Course : std::uint8_t { off, searching, idle, originating, talking };
    struct Stage {
        CdmaState state;
        Milliseconds lasts;
    };
    static std::span<const Stage> stagesOf(Course course);

    void begin(Course next, Milliseconds now);
    void nextStage(MessageBatch& log, const CdmaRadio& radio, Milliseconds now);
    void endCourse(Milliseconds now);
    void lookAround(MessageBatch& log, const CdmaRadio& radio, Milliseconds now);
    void talk(MessageBatch& log, const CdmaRadio& radio, Milliseconds now, Random& random);
    double frameErrorRate(const CdmaCarrier& carrier) const;

    Drift power; // what the network makes of the handset's own idea of its power
    PilotSet pilots{{-13.0, -15.0}};
    Course course = Course::off;
    std::size_t stages = 0; // of the course, that have begun
    Milliseconds stageEnds{};
    Milliseconds nextSystem{};
    bool hasService = false;
    std::uint64_t ticks = 0; // of the call
};

} // namespace pelorus
