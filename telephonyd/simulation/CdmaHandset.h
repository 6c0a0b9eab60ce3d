#pragma once

#include "telephonyd/simulation/CdmaSide.h"
#include "telephonyd/simulation/EvdoSide.h"
#include "telephonyd/simulation/Handset.h"

namespace pelorus {

/// A CDMA2000 handset driven through a town: 1x for calls and pages, EV-DO for data, one receiver for both.
/// Every minute or so somebody talks or loads pages, in turn.
class CdmaHandset : public Handset {
public:
    explicit CdmaHandset(std::uint64_t seed);

    void step(MessageBatch& log) override;

private:
    using Milliseconds = std::chrono::milliseconds;
    enum class Activity : std::uint8_t { starting, idle, call, data, returning };

    void changeActivity();
    void beginNext();
    void live();
    Milliseconds soon(double leastSeconds, double mostSeconds);

    Random random;
    Journey journey;
    CdmaRadio radio;
    CdmaSide cdma;
    EvdoSide evdo;

    Milliseconds now{};
    Milliseconds lastStep{}; // how long it took
    Activity activity = Activity::starting;
    Activity next = Activity::data;
    Milliseconds activityEnds{};
};

} // namespace pelorus
