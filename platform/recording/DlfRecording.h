#pragma once

#include "platform/recording/Recording.h"

namespace pelorus {

/// A DLF file: log records one behind the other, the first of them a version report. Each gives a message
/// with a log-type byte of 1 before it.
///
/// In a DLF file that a snapshot carries, the log-type bytes and prefixes of the messages still stand between
/// the records, but for the first byte of each refresh. A file that is no plain sequence of records is read
/// so, and a log-type byte that stands there is kept.
class DlfRecording : public RecordingReader {
public:
    static bool looksLikeOne(std::span<const std::byte> start);
    static std::unique_ptr<RecordingReader> open(std::vector<std::byte> content, std::string& why);

    Next next(RecordedMessage& message) override;

private:
    explicit DlfRecording(std::vector<std::byte> bytes);

    /// How well the bytes can be read on from some place.
    struct Outlook {
        int records = -1;     // that follow each other, as far as was looked; -1: not even one
        int plainRecords = 0; // of them without a log-type byte before
    };
    bool isPlainSequence() const;
    bool hasFraming(std::size_t place, std::size_t length) const;
    Outlook outlook(std::size_t place, std::size_t framing, int depth) const;
    std::size_t bestFraming(std::size_t place) const;

    std::vector<std::byte> content;
    std::vector<std::byte> current;
    std::size_t offset = 0;
    RecordedTime time;
    bool plain;
};

} // namespace pelorus
