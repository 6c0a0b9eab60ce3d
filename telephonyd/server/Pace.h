#pragma once

#include <chrono>
#include <cstdint>
#include <optional>

namespace pelorus {

/// When each message goes out, counted from the start of the stream.
class Pace {
public:
    using Time = std::chrono::nanoseconds;

    /// The source's own gaps, `speed` times as fast; with 0 there are none.
    static Pace ownTiming(double speed);
    /// Evenly, whatever the source's clock says.
    static Pace rate(double messagesPerSecond);

    /// The next message of the source is at `time` on its clock; where that goes back there is no gap.
    void advance(Time time);
    /// When the message that advance() was last called for is due.
    Time due() const;
    /// That message went out.
    void sent() { ++count; }
    /// The source begins again. A round that took no time at all is followed by a pause, lest a loop flood
    /// the client (at a speed of 0 that is what is asked for).
    void startOver();

private:
    double speed = 0;
    double interval = 0; // nanoseconds; 0 for own timing
    std::uint64_t count = 0;
    Time position{};
    Time roundBegan{};
    std::optional<Time> last;
};

} // namespace pelorus
