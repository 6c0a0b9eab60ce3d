#pragma once

#include <cstddef>
#include <optional>

namespace pelorus {

/// What must be so for a time before it counts (Treselection, time-to-trigger).
class TimeToTrigger {
public:
    explicit TimeToTrigger(double time) : needed(time) {}

    /// Whether the target has been the same for that long, `seconds` after the last call.
    bool holds(std::optional<std::size_t> target, double seconds);
    void reset() { current.reset(); }

private:
    double needed;
    double held = 0;
    std::optional<std::size_t> current;
};

} // namespace pelorus
