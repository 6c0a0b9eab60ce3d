#pragma once

#include "platform/linux/FileDescriptor.h"

#include <vector>

namespace pelorus {

/// The sockets that the service manager started this process with (sd_listen_fds(3)). They are handed over
/// once, and no program that this one starts gets them.
std::vector<FileDescriptor> takePassedSockets();

} // namespace pelorus
