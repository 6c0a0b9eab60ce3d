#pragma once

#include "telephonyd/simulation/GsmPackets.h"
#include "telephonyd/simulation/NetworkPackets.h"
#include "telephonyd/simulation/TimeToTrigger.h"
#include "telephonyd/simulation/UmtsRadio.h"

namespace pelorus {

/// The half of a GSM/UMTS handset that deals with GSM cells.
class GsmSide {
public:
    using Milliseconds = std::chrono::milliseconds;

    GsmSide(Point where, Random& random) : receiver(where, random), interference(random) {}

    void advance(const Journey& journey, double seconds, Random& random);
    const GsmRadio& radio() const { return receiver; }
    std::size_t serving() const { return servingCell; }
    RegistrationArea area() const;

    void enter(MessageBatch& log, std::size_t cell);
    /// A dedicated channel for signalling, or for speech.
    void writeSignallingChannel(MessageBatch& log) const;
    void writeTrafficChannel(MessageBatch& log) const;
    void setTalking(bool isTalking);

    /// Between two reports.
    Milliseconds period() const;
    void report(MessageBatch& log, const UmtsRadio& umts, Random& random);

    /// The cell that the handset would rather be in.
    std::optional<std::size_t> target();

private:
    void reportIdle(MessageBatch& log, const UmtsRadio& umts);
    void reportDedicated(MessageBatch& log, Random& random);
    GsmQuality quality(Random& random) const;

    GsmRadio receiver;
    Drift interference;
    TimeToTrigger change{2.0};
    std::size_t servingCell = 0;
    bool talking = false;
    bool silent = false;
    std::uint64_t reports = 0;
};

} // namespace pelorus
