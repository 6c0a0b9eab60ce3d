#pragma once

namespace pelorus {

/// Whether there is a session bus. Connecting to one where there is none could start one.
bool isThereASessionBus();

} // namespace pelorus
