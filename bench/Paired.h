#pragma once

#include <benchmark/benchmark.h>

#include <algorithm>
#include <ctime>
#include <vector>

namespace pelorus::bench {

inline double secondsOf(clockid_t clock)
{
    timespec now{};
    clock_gettime(clock, &now);
    return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) * 1e-9;
}

/// Processor time and not the time of day: whoever else runs on the machine then costs nothing.
inline double processorSeconds()
{
    return secondsOf(CLOCK_PROCESS_CPUTIME_ID);
}

/// The value below which `share` of them lie.
inline double quantile(std::vector<double> values, double share)
{
    if (values.empty())
        return 0;
    std::sort(values.begin(), values.end());
    return values[static_cast<std::size_t>(share * static_cast<double>(values.size() - 1) + 0.5)];
}

/// Runs two ways of doing `items` pieces of work in turn, so that what else the machine does meets both, and
/// reports how many times as fast ours is by the clock `seconds`: the median of the rounds, and the
/// quartiles.
template <class Seconds, class Ours, class Theirs>
void compare(benchmark::State& run, Seconds seconds, std::size_t items, Ours ours, Theirs theirs)
{
    const auto timed = [&seconds](auto& work) {
        const double begin = seconds();
        work();
        return seconds() - begin;
    };
    ours(); // what only the first time costs belongs to neither
    theirs();
    std::vector<double> ourRates;
    std::vector<double> theirRates;
    std::vector<double> ratios;
    for ([[maybe_unused]] auto _ : run) {
        const double theirTime = timed(theirs);
        const double ourTime = timed(ours);
        run.SetIterationTime(ourTime + theirTime);
        ourRates.push_back(static_cast<double>(items) / ourTime);
        theirRates.push_back(static_cast<double>(items) / theirTime);
        ratios.push_back(theirTime / ourTime);
    }
    run.counters["ours"] = quantile(ourRates, 0.5);
    run.counters["theirs"] = quantile(theirRates, 0.5);
    run.counters["ratio"] = quantile(ratios, 0.5);
    run.counters["low"] = quantile(ratios, 0.25);
    run.counters["high"] = quantile(ratios, 0.75);
}

} // namespace pelorus::bench
