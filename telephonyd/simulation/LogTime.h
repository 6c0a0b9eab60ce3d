#pragma once

#include <chrono>
#include <cstdint>

namespace pelorus {

using HandsetTime = std::chrono::sys_time<std::chrono::nanoseconds>;

/// The time stamp of a log record: the upper 48 bits count 1.25 ms since 6 January 1980 (the epoch of CDMA
/// system time; leap seconds are not counted), the lower 16 bits are a fraction of that.
constexpr std::uint64_t logTime(HandsetTime time)
{
    using namespace std::chrono;
    constexpr HandsetTime epoch = sys_days(1980y / January / 6);
    constexpr std::uint64_t unit = 1'250'000; // nanoseconds
    const auto passed = static_cast<std::uint64_t>((time - epoch).count());
    return passed / unit << 16 | (passed % unit << 16) / unit;
}

} // namespace pelorus
