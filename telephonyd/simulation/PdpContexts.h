#pragma once

#include "platform/Value.h"

namespace pelorus {

/// The packet data contexts of the simulated subscriber: the one that is always on, and while a data session
/// runs one more.
Value pdpContexts(bool inSession);

} // namespace pelorus
