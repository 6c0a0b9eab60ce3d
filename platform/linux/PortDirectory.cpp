#include "platform/linux/PortDirectory.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <fmt/format.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <sys/un.h>

namespace pelorus {

namespace {

std::string withoutTrailingSlashes(std::string path)
{
    while (path.size() > 1 && path.back() == '/')
        path.pop_back(); // with one, the system would follow a symbolic link
    return path;
}

} // namespace

std::string PortDirectory::locate()
{
    if (const char* chosen = std::getenv("PELORUS_PORT_DIRECTORY"); chosen && *chosen)
        return std::filesystem::absolute(chosen).string();
    // A relative path there is to be ignored (XDG base directories).
    if (const char* runtime = std::getenv("XDG_RUNTIME_DIR"); runtime && *runtime == '/')
        return withoutTrailingSlashes(runtime) + "/pelorus";
    return fmt::format("/tmp/pelorus-{}", ::getuid());
}

std::optional<PortDirectory> PortDirectory::open(const std::string& path, std::string& why)
{
    const std::string directory = withoutTrailingSlashes(path);
    const auto refuse = [&](std::string_view reason) {
        why = fmt::format("port directory {}: {}", directory, reason);
        return std::nullopt;
    };

    const bool made = ::mkdir(directory.c_str(), 0700) == 0;
    if (!made && errno != EEXIST)
        return refuse(fmt::format("cannot be made: {}", std::strerror(errno)));

    struct stat status = {};
    if (::lstat(directory.c_str(), &status) != 0)
        return refuse(std::strerror(errno));
    if (S_ISLNK(status.st_mode))
        return refuse("is a symbolic link");
    if (!S_ISDIR(status.st_mode))
        return refuse("is not a directory");
    if (status.st_uid != ::geteuid())
        return refuse(fmt::format("belongs to user {}, not to user {}", status.st_uid, ::geteuid()));
    if ((status.st_mode & (S_IWGRP | S_IWOTH)) != 0)
        return refuse(fmt::format("other users can write to it (mode {:04o})", status.st_mode & 07777));
    return PortDirectory(directory);
}

std::optional<std::string> PortDirectory::socketPath(const std::string& name, std::string& why) const
{
    constexpr std::size_t limit = sizeof(sockaddr_un::sun_path) - 1;
    if (name.empty() || name == "." || name == ".." || name.find('/') != std::string::npos ||
        name.find('\0') != std::string::npos) {
        why = fmt::format("\"{}\" cannot be the name of a port", name);
        return std::nullopt;
    }
    std::string path = directory + '/' + name;
    if (path.size() > limit) {
        why =
            fmt::format("{}: the path of a port has {} bytes at most, this has {}", path, limit, path.size());
        return std::nullopt;
    }
    return path;
}

FileDescriptor PortDirectory::lock(std::string& why) const
{
    FileDescriptor descriptor(::open(directory.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    if (descriptor) {
        int result = 0;
        do
            result = ::flock(descriptor.get(), LOCK_EX);
        while (result != 0 && errno == EINTR);
        if (result == 0)
            return descriptor;
    }
    why = fmt::format("port directory {}: cannot be locked: {}", directory, std::strerror(errno));
    return FileDescriptor();
}

} // namespace pelorus
