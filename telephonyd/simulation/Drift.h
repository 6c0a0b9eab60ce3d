#pragma once

#include "telephonyd/simulation/Random.h"

#include <cmath>

namespace pelorus {

/// How much of a drifting value is still there after a step, given how far the step reaches (in time or
/// way) and how far it takes for the memory to fade.
class Fading {
public:
    Fading(double reach, double memory)
        : kept(std::exp(-reach / memory)), renewed(std::sqrt(1.0 - kept * kept))
    {}

    double apply(double value, Random& random) const { return kept * value + renewed * random.normal(); }

private:
    double kept;
    double renewed;
};

/// A value that wanders around 0 with deviation 1, and forgets where it came from (first-order
/// autoregressive).
class Drift {
public:
    explicit Drift(Random& random) : value(random.normal()) {}

    void advance(const Fading& fading, Random& random) { value = fading.apply(value, random); }
    double now() const { return value; }

private:
    double value;
};

} // namespace pelorus
