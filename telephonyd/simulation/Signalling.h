#pragma once

#include "telephonyd/simulation/MessageBatch.h"

#include <array>
#include <optional>

namespace pelorus {

/// What happens to the handset in the course of a procedure.
enum class HandsetEvent : std::uint8_t {
    gsmCellEntered,
    umtsCellEntered,
    signallingChannel, // a dedicated one of GSM
    trafficChannel,
    callBegins,
    dataBegins,
    activityEnds,
    contextsChange,
    locationUpdated,
    routingUpdated,
    registered,
};

/// One step of a procedure: a layer reports its state, or something happens.
struct SignallingStep {
    enum class Kind : std::uint8_t { registration, mm, gmm, rr, rrc, ciphering, event };

    std::chrono::milliseconds after; // the step before
    Kind kind;
    std::array<std::uint8_t, 3> values;
};

using Procedure = std::span<const SignallingStep>;

/// Runs the procedures of a GSM/UMTS handset, one behind the other, and logs the states: 0x7132, 0x7131,
/// 0x7130, 0x512C, 0x4125, 0x4157.
class Signalling {
public:
    using Milliseconds = std::chrono::milliseconds;

    bool isBusy() const { return next < steps.size(); }
    /// Begins at `now`, or behind what is still running.
    void start(Procedure procedure, Milliseconds now);
    /// Logs what is due before `end`, up to the next event, which is the caller's business; to be called
    /// again until there is none.
    std::optional<HandsetEvent> run(MessageBatch& log, Milliseconds end);

private:
    struct TimedStep {
        Milliseconds due;
        SignallingStep step;
    };

    std::vector<TimedStep> steps;
    std::size_t next = 0;
};

} // namespace pelorus
