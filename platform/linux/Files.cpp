#include "platform/linux/Files.h"

#include "platform/linux/FileDescriptor.h"

#include <algorithm>
#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>

namespace pelorus {

bool writeAll(int descriptor, std::span<const std::byte> bytes)
{
    while (!bytes.empty()) {
        const ssize_t count = ::write(descriptor, bytes.data(), bytes.size());
        if (count >= 0)
            bytes = bytes.subspan(static_cast<std::size_t>(count));
        else if (errno != EINTR)
            return false;
    }
    return true;
}

std::optional<std::vector<std::byte>> readWholeFile(const std::string& path)
{
    const FileDescriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC));
    struct stat status = {};
    if (!file || ::fstat(file.get(), &status) != 0 || S_ISDIR(status.st_mode))
        return std::nullopt;

    // The size is a hint only: a pipe has none, and a file may grow meanwhile.
    std::vector<std::byte> bytes;
    std::size_t length = 0;
    bytes.resize(std::clamp<std::size_t>(static_cast<std::size_t>(status.st_size), 4095, kLongestFile) + 1);
    for (;;) {
        const ssize_t count = ::read(file.get(), bytes.data() + length, bytes.size() - length);
        if (count < 0 && errno == EINTR)
            continue;
        if (count < 0)
            return std::nullopt;
        if (count == 0)
            break;
        length += static_cast<std::size_t>(count);
        if (length > kLongestFile)
            return std::nullopt;
        if (length == bytes.size())
            bytes.resize(std::min(2 * length, kLongestFile + 1));
    }
    bytes.resize(length);
    return bytes;
}

bool writeWholeFile(const std::string& path, std::span<const std::byte> bytes)
{
    FileDescriptor file(::open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0666));
    if (!file)
        return false;
    const bool written = writeAll(file.get(), bytes);
    return file.close() && written; // a full disk may show at the end only
}

} // namespace pelorus
