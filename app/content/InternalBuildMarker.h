#pragma once

#include "platform/Platform.h"

namespace pelorus {

/// Whether this is one of the maker's internal builds: a marker is in its place on the handset, or at the
/// same place below the program's data directory.
bool isInternalBuild(Platform& platform, const std::string& dataDirectory);

} // namespace pelorus
