#include "telephonyd/simulation/TimeToTrigger.h"

namespace pelorus {

bool TimeToTrigger::holds(std::optional<std::size_t> target, double seconds)
{
    if (!target || target != current) {
        current = target;
        held = 0;
        return false;
    }
    held += seconds;
    return held >= needed;
}

} // namespace pelorus
