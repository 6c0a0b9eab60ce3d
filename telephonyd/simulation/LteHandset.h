#pragma once

#include "telephonyd/simulation/Handset.h"
#include "telephonyd/simulation/LteCellChoice.h"
#include "telephonyd/simulation/LtePackets.h"
#include "telephonyd/simulation/LteServerMessages.h"
#include "telephonyd/simulation/TimeToTrigger.h"

namespace pelorus {

/// An LTE handset driven through a town. Idle it measures in every DRX cycle and reselects cells; every
/// minute or two a data session connects it, then it measures more often and is handed over.
class LteHandset : public Handset {
public:
    explicit LteHandset(std::uint64_t seed);

    void step(MessageBatch& log) override;

private:
    using Milliseconds = std::chrono::milliseconds;

    void switchOn(MessageBatch& log);
    void camp(MessageBatch& log);
    void talk(MessageBatch& log);

    void live(Milliseconds time, double gain);
    void updateMeasurementRules();
    void reportOtherCarrier(MessageBatch& log, std::optional<std::size_t> target);
    void reportCandidate(MessageBatch& log, std::optional<std::size_t> target);
    void enterCell(MessageBatch& log, std::size_t cell);
    void setConnected(MessageBatch& log, bool isConnected);
    /// What the telephony server repeats from time to time.
    void repeatWhatIsDue(MessageBatch& log);
    Milliseconds soon(double leastSeconds, double mostSeconds);

    Random random;
    Journey journey;
    LteRadio radio;
    LteSurroundings surroundings;
    LteServerMessages server;
    LteReselectionCandidates turns;
    std::vector<ReselectionCandidate> candidates;
    Drift frequencyError;

    Milliseconds now{};
    bool isOn = false;
    bool connected = false;
    Milliseconds phaseEnds{}; // of idle or connected
    std::size_t serving = 0;
    std::uint64_t cycles = 0; // of DRX
    LteMeasurementRules rules;
    TimeToTrigger reselection;
    TimeToTrigger handover;
    Milliseconds nextCellList{};
    Milliseconds nextSearch{};
    Milliseconds nextSim{};
};

} // namespace pelorus
