#pragma once

#include <cmath>

namespace pelorus {

inline double milliwatts(double dBm)
{
    return std::exp2(dBm * 0.33219281);
}

inline double decibels(double ratio)
{
    return 3.01029996 * std::log2(ratio);
}

} // namespace pelorus
