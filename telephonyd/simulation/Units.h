#pragma once

#include <chrono>
#include <cmath>

namespace pelorus {

inline double inSeconds(std::chrono::milliseconds time)
{
    return std::chrono::duration<double>(time).count();
}

/// To the nearest whole number, as fields hold it.
inline int rounded(double value)
{
    return static_cast<int>(std::lround(value));
}

} // namespace pelorus
