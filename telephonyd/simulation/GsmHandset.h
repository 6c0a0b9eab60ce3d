#pragma once

#include "telephonyd/simulation/GsmCellMonitor.h"
#include "telephonyd/simulation/GsmSide.h"
#include "telephonyd/simulation/Handset.h"
#include "telephonyd/simulation/Procedures.h"
#include "telephonyd/simulation/SubscriberMessages.h"
#include "telephonyd/simulation/UmtsSide.h"

namespace pelorus {

/// A GSM/UMTS handset driven through a town whose UMTS has a hole. It prefers UMTS, falls back to GSM where
/// that wears out, tells the network when it crosses the border of an area, and every minute or so makes a
/// call or opens a data session.
class GsmHandset : public Handset {
public:
    explicit GsmHandset(std::uint64_t seed);

    void step(MessageBatch& log) override;

private:
    using Milliseconds = std::chrono::milliseconds;
    enum class Technology { none, gsm, umts };

    Milliseconds period() const;
    void live(Milliseconds time);
    Milliseconds soon(double leastSeconds, double mostSeconds);

    void report(MessageBatch& log);
    /// Begins what is to be done, if anything.
    void decide();
    bool keepRegistered();
    std::optional<std::size_t> otherTechnologyTarget() const;
    void start(Procedure procedure) { signalling.start(procedure, now); }
    const Procedures& procedures() const { return inGsm() ? kGsmProcedures : kUmtsProcedures; }

    void perform(HandsetEvent event, MessageBatch& log);
    void enterGsm(MessageBatch& log);
    void enterUmts(MessageBatch& log, std::size_t cell);
    void begin(Activity newActivity);
    void end();
    void writeCells(MessageBatch& log);
    /// What the telephony server repeats from time to time.
    void repeatWhatIsDue(MessageBatch& log);

    bool inGsm() const { return technology == Technology::gsm; }
    RegistrationArea area() const { return inGsm() ? gsm.area() : umts.area(); }

    Random random;
    Journey journey;
    GsmSide gsm;
    UmtsSide umts;
    GsmCellMonitor cellMonitor;
    SubscriberMessages subscriber;
    Signalling signalling;
    TimeToTrigger leaving{2.0}; // for the other technology

    Milliseconds now{};
    Technology technology = Technology::none;
    Activity activity = Activity::idle;
    std::size_t target = 0; // of a cell change under way
    RegistrationArea registered;
    Technology routingTechnology = Technology::none; // where the routing area was updated last
    std::array<Activity, 2> nextActivity{Activity::call, Activity::data}; // in GSM, in UMTS
    Milliseconds phaseEnds{};                                             // of idle or an activity
    Milliseconds nextSearch{};                                            // for UMTS, while in GSM
    Milliseconds nextCellList{};
    Milliseconds nextSim{};
};

} // namespace pelorus
