#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <vector>

namespace pelorus {

using RecordedTime = std::chrono::sys_time<std::chrono::nanoseconds>;

/// The moment so long after 1970. Files can tell times that 64 bits of nanoseconds cannot: those become the
/// end of what they can, some 250 years before and after.
RecordedTime recordedTime(std::int64_t seconds, std::int64_t nanoseconds = 0);

/// One log message as it was received, and when.
struct RecordedMessage {
    RecordedTime time;
    std::span<const std::byte> bytes; // valid until the next message is read
};

/// Reads the messages of a recording in order. A recording is a pcap or pcapng file of link type 147 (USER0),
/// a snapshot file (the raw messages of its "DisplayState" buffers), or a DLF file (each record behind a
/// log-type byte of 1); its content tells which.
///
/// Where a file tells no time of arrival: messages of a snapshot carry the date of their entry, those of a
/// DLF file the time of its version report.
class RecordingReader {
public:
    enum class Next { message, end, failed };

    virtual ~RecordingReader() = default;

    /// Null when the file is none; `why` is then one line without its name.
    static std::unique_ptr<RecordingReader> open(const std::string& path, std::string& why);

    /// After `failed`, why() says what is wrong with the file; the messages before stand.
    virtual Next next(RecordedMessage& message) = 0;
    const std::string& why() const { return reason; }

protected:
    RecordingReader() = default;
    RecordingReader(const RecordingReader&) = delete;
    RecordingReader& operator=(const RecordingReader&) = delete;

    std::string reason;
};

} // namespace pelorus
