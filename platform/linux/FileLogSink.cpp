#include "platform/linux/FileLogSink.h"

#include "platform/linux/Files.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <fmt/format.h>
#include <iterator>

namespace pelorus {

std::unique_ptr<FileLogSink> FileLogSink::open(const std::string& path, std::string& why)
{
    // Appending keeps lines whole when the file is somebody else's output too.
    FileDescriptor file(
        path == "-" ? ::fcntl(STDERR_FILENO, F_DUPFD_CLOEXEC, 0)
                    : ::open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_APPEND | O_CLOEXEC, 0666));
    if (!file) {
        why = std::strerror(errno);
        return nullptr;
    }
    return std::unique_ptr<FileLogSink>(new FileLogSink(std::move(file)));
}

void FileLogSink::write(int priority, std::string_view text)
{
    while (text.ends_with('\n'))
        text.remove_suffix(1);
    line.clear();
    fmt::format_to(std::back_inserter(line), "<{}>{}\n", priority, text);
    if (!writeAll(file.get(), std::as_bytes(std::span(line))) && firstError == 0)
        firstError = errno;
}

} // namespace pelorus
