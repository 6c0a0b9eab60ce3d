#pragma once

#include "LogGenerator/LogGenerator.h"

namespace pelorus {

/// The running frame-error rate of the 1x traffic channel, 0 to 1 in single precision: state["TrafficFER"].
std::optional<float> trafficErrorRate(const State& state);
void setTrafficErrorRate(State& state, float rate);
void forgetTrafficErrorRate(State& state);

} // namespace pelorus
