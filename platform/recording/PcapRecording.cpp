#include "platform/recording/PcapRecording.h"

#include <array>
#include <fmt/format.h>
#include <pcap/pcap.h>
#include <string_view>

namespace pelorus {

namespace {

constexpr int kLinkType = DLT_USER0;
static_assert(kLinkType == 147);

std::string withoutName(std::string_view text, const std::string& path)
{
    const std::string prefix = path + ": ";
    if (text.starts_with(prefix))
        text.remove_prefix(prefix.size());
    return std::string(text);
}

} // namespace

std::unique_ptr<RecordingReader> PcapRecording::open(File content, std::string& why)
{
    std::array<char, PCAP_ERRBUF_SIZE> error{};
    pcap* file =
        pcap_fopen_offline_with_tstamp_precision(content.get(), PCAP_TSTAMP_PRECISION_NANO, error.data());
    if (!file) {
        why = error.data();
        return nullptr;
    }
    static_cast<void>(content.release()); // pcap_close() closes it
    std::unique_ptr<PcapRecording> recording(new PcapRecording(file));
    if (const int linkType = pcap_datalink(file); linkType != kLinkType) {
        const char* name = pcap_datalink_val_to_name(linkType);
        why = fmt::format("recorded from link type {} ({}), not from a log channel ({}, USER0)", linkType,
                          name ? name : "unknown", kLinkType);
        return nullptr;
    }
    return recording;
}

PcapRecording::~PcapRecording()
{
    pcap_close(file);
}

RecordingReader::Next PcapRecording::next(RecordedMessage& message)
{
    pcap_pkthdr* header = nullptr;
    const u_char* bytes = nullptr;
    switch (pcap_next_ex(file, &header, &bytes)) {
    case 1:
        break;
    case PCAP_ERROR_BREAK:
        return Next::end;
    default:
        reason = fmt::format("broken after {} messages: {}", messages, pcap_geterr(file));
        return Next::failed;
    }
    if (header->caplen < header->len) {
        reason = fmt::format("message {} was recorded cut short, {} of its {} bytes", messages + 1,
                             header->caplen, header->len);
        return Next::failed;
    }
    ++messages;
    message.time = recordedTime(header->ts.tv_sec, header->ts.tv_usec);
    message.bytes = std::as_bytes(std::span(bytes, header->caplen));
    return Next::message;
}

std::unique_ptr<RecordingWriter> RecordingWriter::create(const std::string& path, std::string& why)
{
    pcap* format = pcap_open_dead_with_tstamp_precision(kLinkType, static_cast<int>(longestMessage),
                                                        PCAP_TSTAMP_PRECISION_NANO);
    pcap_dumper* file = pcap_dump_open(format, path.c_str());
    if (!file) {
        why = withoutName(pcap_geterr(format), path);
        pcap_close(format);
        return nullptr;
    }
    return std::unique_ptr<RecordingWriter>(new RecordingWriter(format, file));
}

RecordingWriter::~RecordingWriter()
{
    pcap_dump_close(file);
    pcap_close(format);
}

bool RecordingWriter::write(const RecordedMessage& message)
{
    if (message.bytes.size() > longestMessage)
        return false;
    const auto sinceEpoch = message.time.time_since_epoch();
    const auto seconds = std::chrono::floor<std::chrono::seconds>(sinceEpoch);
    pcap_pkthdr header{};
    header.ts.tv_sec = seconds.count();
    header.ts.tv_usec = (sinceEpoch - seconds).count(); // nanoseconds in a file of that precision
    header.caplen = header.len = static_cast<bpf_u_int32>(message.bytes.size());
    pcap_dump(reinterpret_cast<u_char*>(file), &header,
              reinterpret_cast<const u_char*>(message.bytes.data()));
    return std::ferror(pcap_dump_file(file)) == 0;
}

bool RecordingWriter::flush()
{
    return pcap_dump_flush(file) == 0;
}

} // namespace pelorus
