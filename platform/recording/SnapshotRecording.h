#pragma once

#include "platform/Value.h"
#include "platform/recording/Recording.h"

namespace pelorus {

/// A snapshot file: the raw messages of its entries, oldest first.
class SnapshotRecording : public RecordingReader {
public:
    static bool looksLikeOne(std::span<const std::byte> start);
    static std::unique_ptr<RecordingReader> open(std::span<const std::byte> content, std::string& why);

    Next next(RecordedMessage& message) override;

private:
    struct Entry {
        std::size_t number; // among all of the snapshot
        Data messages;
        RecordedTime time;
    };

    std::vector<Entry> entries;
    std::size_t entry = 0;
    std::size_t offset = 0;
};

/// The moment of a date's default textual form ("2012-05-04 09:30:00 +0000"); 1970 for any other text.
RecordedTime timeOfDateText(const std::string& text);

} // namespace pelorus
