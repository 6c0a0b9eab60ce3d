#pragma once

#include "platform/linux/FileDescriptor.h"

#include <optional>
#include <string>

namespace pelorus {

/// The directory that this user's ports live in. Whoever can write to it could pose as any port, so it must
/// belong to this user alone. `why` is one line that names the directory.
class PortDirectory {
public:
    /// $PELORUS_PORT_DIRECTORY, else $XDG_RUNTIME_DIR/pelorus, else /tmp/pelorus-UID.
    static std::string locate();
    /// Makes the directory (mode 0700) when it is missing. Nothing when it must be refused.
    static std::optional<PortDirectory> open(std::string& why) { return open(locate(), why); }
    static std::optional<PortDirectory> open(const std::string& path, std::string& why);

    const std::string& path() const { return directory; }
    /// Where the port of that name listens. Nothing for a name that cannot be one.
    std::optional<std::string> socketPath(const std::string& name, std::string& why) const;
    /// Keeps other processes from making or removing ports here while the descriptor is open.
    FileDescriptor lock(std::string& why) const;

private:
    explicit PortDirectory(std::string path) : directory(std::move(path)) {}

    std::string directory;
};

} // namespace pelorus
