#pragma once

#include <functional>

namespace pelorus {

/// Runs the closure from the event loop, after what is queued already.
void postToMainQueue(std::function<void()> closure);

} // namespace pelorus
