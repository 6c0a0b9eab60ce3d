#pragma once

#include <chrono>
#include <optional>

namespace pelorus {

/// When a call that is made again and again may be made next: one at a time, with pauses that double while it
/// fails, and never more once it turned out to be impossible. Is told the time.
class CallSchedule {
public:
    using Clock = std::chrono::steady_clock;
    using Time = Clock::time_point;

    explicit CallSchedule(std::chrono::milliseconds interval) : interval(interval) {}

    /// Nothing while a call is on its way, and for a call that is impossible.
    std::optional<Time> due() const { return inFlight || impossible ? std::nullopt : std::optional(next); }
    void started() { inFlight = true; }
    void succeeded(Time now);
    void failed(Time now);
    void isImpossible();
    /// What made it fail may be over.
    void retryAt(Time now);

private:
    static constexpr std::chrono::milliseconds kLongestPause = std::chrono::minutes(5);

    std::chrono::milliseconds interval;
    std::chrono::milliseconds pause{}; // 0 unless the last call failed
    Time next{};
    bool inFlight = false;
    bool impossible = false;
};

} // namespace pelorus
