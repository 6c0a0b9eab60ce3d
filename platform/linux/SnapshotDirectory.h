#pragma once

#include <string>

namespace pelorus {

/// Where snapshot files go: the handset's directory of crash reports where there is one, else
/// $XDG_STATE_HOME/pelorus/CrashReporter (default ~/.local/state), made when it is missing. One that cannot
/// be made is returned all the same, so that it is the writing of the file that fails and is reported.
std::string findSnapshotDirectory(const std::string& handset = "/var/mobile/Library/Logs/CrashReporter");

} // namespace pelorus
