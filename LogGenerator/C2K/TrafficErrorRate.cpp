#include "LogGenerator/C2K/TrafficErrorRate.h"

namespace pelorus {

namespace {

constexpr Label kKey = "TrafficFER";

} // namespace

std::optional<float> trafficErrorRate(const State& state)
{
    const Value* value = state.find(kKey.text);
    if (value && value->real())
        return static_cast<float>(*value->real());
    if (value && value->integer())
        return static_cast<float>(*value->integer());
    return std::nullopt;
}

void setTrafficErrorRate(State& state, float rate)
{
    state.set(kKey, double{rate});
}

void forgetTrafficErrorRate(State& state)
{
    state.remove(kKey.text);
}

} // namespace pelorus
