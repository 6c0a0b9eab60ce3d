#pragma once

#include "telephonyd/simulation/CellMonitorList.h"
#include "telephonyd/simulation/GsmRadio.h"
#include "telephonyd/simulation/Handset.h"
#include "telephonyd/simulation/SubscriberMessages.h"
#include "telephonyd/simulation/TimeToTrigger.h"
#include "telephonyd/simulation/UtranPackets.h"

namespace pelorus {

/// A TDD UMTS handset driven through a town. Idle it measures its neighbours and reselects cells; every
/// minute or so a call or a data session connects it, then it measures more often, is handed over, and goes
/// back to idle through the lower modes.
class UtranHandset : public Handset {
public:
    explicit UtranHandset(std::uint64_t seed);

    void step(MessageBatch& log) override;

private:
    using Milliseconds = std::chrono::milliseconds;
    enum class Course { rising, falling, releasing }; // to CELL_DCH, to a paging mode, to idle

    Milliseconds period() const;
    void live(Milliseconds time);
    Milliseconds soon(double leastSeconds, double mostSeconds);

    void report(MessageBatch& log);
    void switchOn(MessageBatch& log);
    void enterCell(MessageBatch& log, std::size_t cell);
    void changeCell(MessageBatch& log);
    /// Into the mode that follows, where it is time.
    void changeMode(MessageBatch& log);
    void leaveCommonChannel(MessageBatch& log);
    void enterMode(MessageBatch& log, UtranMode next);
    void writeCells(MessageBatch& log);
    /// What the telephony server repeats from time to time.
    void repeatWhatIsDue(MessageBatch& log);

    Random random;
    Journey journey;
    UtranRadio radio;
    GsmRadio gsm;
    UtranTraffic traffic;
    SubscriberMessages subscriber;
    CellMonitorList cellList;
    TimeToTrigger cellChange{1.2};

    Milliseconds now{};
    bool isOn = false;
    UtranMode mode = UtranMode::disconnected;
    Course course = Course::rising;
    bool isData = false;
    std::size_t serving = 0;
    std::uint64_t reports = 0;
    Milliseconds modeEnds{};
    Milliseconds nextCellList{};
    Milliseconds nextSim{};
};

} // namespace pelorus
