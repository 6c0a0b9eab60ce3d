#pragma once

#include "platform/recording/PcapRecording.h"
#include "telephonyd/server/Report.h"

#include <QTimer>

namespace pelorus {

/// Writes down every streamed message, of all channels in one file. What was streamed more than a second ago
/// is in the file, whatever happens to the server. A file that cannot take more ends the recording, not the
/// streaming.
class MessageRecorder {
public:
    /// Null when the file cannot be made; `why` is then one line.
    static std::unique_ptr<MessageRecorder> create(const std::string& path, Report report, std::string& why);
    ~MessageRecorder();
    MessageRecorder(const MessageRecorder&) = delete;
    MessageRecorder& operator=(const MessageRecorder&) = delete;

    void record(std::span<const std::byte> message);
    /// Writes what is left. False when the file does not hold all that it was to hold.
    bool finish();

private:
    MessageRecorder(std::string path, std::unique_ptr<RecordingWriter> writer, Report report);

    void flush();
    void giveUp();

    std::string path;
    std::unique_ptr<RecordingWriter> writer;
    Report report;
    QTimer flushTimer;
    bool unflushed = false;
    bool gaveUp = false;
};

} // namespace pelorus
