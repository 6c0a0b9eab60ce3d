#include "platform/linux/PassedSockets.h"

#include <charconv>
#include <cstdlib>
#include <fcntl.h>
#include <optional>
#include <string_view>

namespace pelorus {

namespace {

constexpr int kFirst = 3; // the descriptors follow standard error's
constexpr int kMost = 64;

std::optional<int> numberIn(const char* variable)
{
    const char* text = std::getenv(variable);
    if (!text)
        return std::nullopt;
    const std::string_view digits = text;
    int number = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number);
    if (error != std::errc() || end != digits.data() + digits.size())
        return std::nullopt;
    return number;
}

} // namespace

std::vector<FileDescriptor> takePassedSockets()
{
    const auto process = numberIn("LISTEN_PID");
    const auto count = numberIn("LISTEN_FDS");
    for (const char* variable : {"LISTEN_PID", "LISTEN_FDS", "LISTEN_FDNAMES"})
        ::unsetenv(variable);
    std::vector<FileDescriptor> sockets;
    if (process != ::getpid() || !count || *count > kMost)
        return sockets;
    for (int descriptor = kFirst; descriptor < kFirst + *count; ++descriptor) {
        const int flags = ::fcntl(descriptor, F_GETFD);
        if (flags < 0)
            continue; // announced, but not there
        ::fcntl(descriptor, F_SETFD, flags | FD_CLOEXEC);
        sockets.emplace_back(descriptor);
    }
    return sockets;
}

} // namespace pelorus
