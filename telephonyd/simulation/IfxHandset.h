#pragma once

#include "telephonyd/simulation/Handset.h"
#include "telephonyd/simulation/IfxSections.h"
#include "telephonyd/simulation/TimeToTrigger.h"

namespace pelorus {

/// A GSM handset with an IFX baseband driven through a town. It sends all that it has to show once or twice a
/// second; what a call or a data transfer adds vanishes with it.
class IfxHandset : public Handset {
public:
    explicit IfxHandset(std::uint64_t seed);

    void step(MessageBatch& log) override;

private:
    using Milliseconds = std::chrono::milliseconds;
    enum class Activity : std::uint8_t { searching, idle, call, data };

    void changeActivity();
    void changeCell();
    std::shared_ptr<Dictionary> display() const;
    IfxConnection connection() const;
    void live();
    Milliseconds soon(double leastSeconds, double mostSeconds);

    Random random;
    Journey journey;
    GsmRadio gsm;
    UmtsRadio umts;
    Drift interference;
    TimeToTrigger cellChange{2.0};

    Milliseconds now{};
    std::size_t serving = 0;
    Activity activity = Activity::searching;
    Activity next = Activity::call;
    Milliseconds activityEnds{};
};

} // namespace pelorus
