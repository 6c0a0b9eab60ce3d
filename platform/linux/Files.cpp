#include "platform/linux/Files.h"

#include "platform/linux/FileDescriptor.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>

namespace pelorus {

namespace {

/// A full disk may show at the end only.
bool finish(FileDescriptor& file, std::span<const std::byte> bytes)
{
    const bool written = writeAll(file.get(), bytes);
    const int error = errno;
    const bool closed = file.close();
    if (!written)
        errno = error;
    return written && closed;
}

} // namespace

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
    if (finish(file, bytes))
        return true;
    const int error = errno;
    struct stat status = {};
    if (::lstat(path.c_str(), &status) == 0 && S_ISREG(status.st_mode))
        ::unlink(path.c_str());
    errno = error;
    return false;
}

bool replaceWholeFile(const std::string& path, std::span<const std::byte> bytes)
{
    struct stat old = {};
    if (::stat(path.c_str(), &old) != 0 || !S_ISREG(old.st_mode))
        return writeWholeFile(path, bytes); // there is nothing to keep
    if (::access(path.c_str(), W_OK) != 0)
        return false;
    std::error_code error;
    const std::filesystem::path target = std::filesystem::canonical(path, error); // links stay links
    if (error) {
        errno = error.value();
        return false;
    }
    std::string temporary = target.parent_path() / ".pelorus-XXXXXX";
    FileDescriptor file(::mkostemp(temporary.data(), O_CLOEXEC));
    if (!file && errno == EACCES)
        return writeWholeFile(path, bytes); // the file may be written, but no other beside it
    if (!file)
        return false;
    const bool ownerKept = ::fchown(file.get(), old.st_uid, old.st_gid) == 0;
    if ((ownerKept || errno == EPERM) && ::fchmod(file.get(), old.st_mode & 07777) == 0 &&
        finish(file, bytes) && ::rename(temporary.c_str(), target.c_str()) == 0)
        return true;
    const int reason = errno;
    ::unlink(temporary.c_str());
    errno = reason;
    return false;
}

} // namespace pelorus
