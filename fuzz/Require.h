#pragma once

#include <cstdio>
#include <cstdlib>
#include <unistd.h>

namespace pelorus::fuzz {

/// A property that must hold whatever the input is: else the input is a finding.
inline void require(bool holds, const char* property)
{
    if (holds)
        return;
    ::dprintf(STDERR_FILENO, "does not hold: %s\n", property); // the stream may be elsewhere
    std::abort();
}

} // namespace pelorus::fuzz
