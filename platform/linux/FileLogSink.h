#pragma once

#include "platform/SystemLog.h"
#include "platform/linux/FileDescriptor.h"

#include <memory>
#include <string>

namespace pelorus {

/// A file that gets each entry as "<P>", the text, and exactly one line feed. Each is in the file when
/// write() returns, so that none is lost whatever ends the program.
class FileLogSink : public SystemLogSink {
public:
    /// "-" is standard error; a file that exists is emptied. Null when the file cannot be opened; `why` is
    /// then the reason, without the file's name.
    static std::unique_ptr<FileLogSink> open(const std::string& path, std::string& why);
    void write(int priority, std::string_view text) override;
    /// What kept an entry out of the file (errno, the first one), or 0.
    int error() const { return firstError; }

private:
    explicit FileLogSink(FileDescriptor file) : file(std::move(file)) {}

    FileDescriptor file;
    std::string line; // reused
    int firstError = 0;
};

} // namespace pelorus
