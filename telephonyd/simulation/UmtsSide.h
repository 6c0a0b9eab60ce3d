#pragma once

#include "telephonyd/simulation/GsmRadio.h"
#include "telephonyd/simulation/NetworkPackets.h"
#include "telephonyd/simulation/UmtsPackets.h"
#include "telephonyd/simulation/UmtsTraffic.h"

namespace pelorus {

/// The half of a GSM/UMTS handset that deals with UMTS cells.
class UmtsSide {
public:
    using Milliseconds = std::chrono::milliseconds;

    UmtsSide(Point where, Random& random) : receiver(where, random) {}

    void advance(const Journey& journey, double seconds, Random& random)
    {
        receiver.advance(journey, seconds, random);
    }
    const UmtsRadio& radio() const { return receiver; }
    std::size_t serving() const { return servingCell; }
    RegistrationArea area() const;

    void enter(MessageBatch& log, std::size_t cell);
    void connect(UmtsTraffic::Kind kind, Random& random);
    void release();

    /// Between two reports.
    Milliseconds period() const;
    void report(MessageBatch& log, const GsmRadio& gsm, Random& random);

    /// The cell that is to serve instead: a better one, or where the active set of a connected handset, which
    /// changes here, has lost the serving one, the best that is left.
    std::optional<std::size_t> target();

    /// That the handset should leave for GSM, or may come back.
    bool isWornOut() const;
    bool isGood() const;

private:
    void reportIdle(MessageBatch& log, const GsmRadio& gsm);
    void reportConnected(MessageBatch& log, Random& random);
    std::optional<std::size_t> reselectionTarget();
    std::optional<std::size_t> followActiveSet();

    UmtsRadio receiver;
    SoftHandover activeSet;
    UmtsTraffic traffic;
    TimeToTrigger reselection{1.0};
    std::size_t servingCell = 0;
    bool connected = false;
    std::uint64_t reports = 0;
};

} // namespace pelorus
