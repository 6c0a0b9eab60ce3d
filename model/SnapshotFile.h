#pragma once

#include "platform/Platform.h"

namespace pelorus {

/// The content of a snapshot file: "Timestamp", "Data", "Description". It ends at the first that is missing,
/// so without save contents only the time stamp is in it.
Value snapshotFileContent(const std::string& timestamp, const std::shared_ptr<Array>& saveContents,
                          const std::string& description);

/// Writes the content to the snapshot directory under the name of the current second, and returns its path.
/// Nothing, and a line in the system log, when that fails; `why` is then the path and what is wrong with it.
std::optional<std::string> writeSnapshotFile(Platform& platform, const Value& content,
                                             std::string* why = nullptr);

} // namespace pelorus
