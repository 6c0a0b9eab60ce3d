#pragma once

#include "platform/recording/DlfFraming.h"
#include "platform/recording/Recording.h"

namespace pelorus {

/// A DLF file: log records one behind the other, the first of them a version report. Each gives a message
/// with a log-type byte of 1 before it; the log-type byte of the file itself where one stands there.
class DlfRecording : public RecordingReader {
public:
    static bool looksLikeOne(std::span<const std::byte> start);
    static std::unique_ptr<RecordingReader> open(std::vector<std::byte> content, std::string& why);

    Next next(RecordedMessage& message) override;

private:
    explicit DlfRecording(std::vector<std::byte> bytes);

    std::vector<std::byte> content;
    DlfFraming framing;
    std::vector<std::byte> current;
    std::size_t offset = 0;
    RecordedTime time;
};

} // namespace pelorus
