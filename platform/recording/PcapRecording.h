#pragma once

#include "platform/recording/Recording.h"

#include <cstdio>

struct pcap;
struct pcap_dumper;

namespace pelorus {

/// A pcap or pcapng file, one packet a message.
class PcapRecording : public RecordingReader {
public:
    using File = std::unique_ptr<std::FILE, int (*)(std::FILE*)>;
    static std::unique_ptr<RecordingReader> open(File content, std::string& why);
    ~PcapRecording() override;

    Next next(RecordedMessage& message) override;

private:
    explicit PcapRecording(pcap* opened) : file(opened) {}

    pcap* file;
    std::size_t messages = 0;
};

/// Writes a pcap file with nanosecond time stamps.
class RecordingWriter {
public:
    /// The longest message that a pcap file can hold.
    static constexpr std::size_t longestMessage = 262'144;

    /// Null when the file cannot be made; `why` is then one line without its name.
    static std::unique_ptr<RecordingWriter> create(const std::string& path, std::string& why);
    ~RecordingWriter();
    RecordingWriter(const RecordingWriter&) = delete;
    RecordingWriter& operator=(const RecordingWriter&) = delete;

    /// False for a message that is too long, and when the file cannot take it.
    bool write(const RecordedMessage& message);
    /// Hands everything written so far to the system. False when that fails.
    bool flush();

private:
    RecordingWriter(pcap* pcapFormat, pcap_dumper* opened) : format(pcapFormat), file(opened) {}

    pcap* format;
    pcap_dumper* file;
};

} // namespace pelorus
