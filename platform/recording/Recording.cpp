#include "platform/recording/Recording.h"

#include "platform/recording/DlfRecording.h"
#include "platform/recording/PcapRecording.h"
#include "platform/recording/SnapshotRecording.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <fstream>
#include <iterator>

namespace pelorus {

namespace {

constexpr std::array<unsigned char, 4> kPcapMagics[] = {
    {0xD4, 0xC3, 0xB2, 0xA1}, {0xA1, 0xB2, 0xC3, 0xD4}, // microseconds
    {0x4D, 0x3C, 0xB2, 0xA1}, {0xA1, 0xB2, 0x3C, 0x4D}, // nanoseconds
    {0x0A, 0x0D, 0x0D, 0x0A},                           // pcapng
};

bool isPcap(std::span<const std::byte> start)
{
    return start.size() >= 4 &&
           std::any_of(std::begin(kPcapMagics), std::end(kPcapMagics), [start](const auto& magic) {
               return std::memcmp(magic.data(), start.data(), magic.size()) == 0;
           });
}

} // namespace

std::unique_ptr<RecordingReader> RecordingReader::open(const std::string& path, std::string& why)
{
    std::ifstream file(path, std::ios::binary);
    if (!file) {
        why = std::strerror(errno);
        return nullptr;
    }
    std::array<char, 512> start{};
    file.read(start.data(), start.size());
    if (file.bad() || (file.fail() && !file.eof())) {
        why = std::strerror(errno);
        return nullptr;
    }
    const auto head = std::as_bytes(std::span(start)).first(static_cast<std::size_t>(file.gcount()));
    if (head.empty()) {
        why = "the file is empty";
        return nullptr;
    }
    if (isPcap(head))
        return PcapRecording::open(path, why);
    if (!SnapshotRecording::looksLikeOne(head) && !DlfRecording::looksLikeOne(head)) {
        why = "no recording: neither pcap or pcapng, nor a snapshot, nor a DLF file";
        return nullptr;
    }
    file.clear();
    file.seekg(0);
    const std::vector<char> content{std::istreambuf_iterator<char>(file), {}};
    const auto bytes = std::as_bytes(std::span(content));
    if (SnapshotRecording::looksLikeOne(head))
        return SnapshotRecording::open(bytes, why);
    return DlfRecording::open({bytes.begin(), bytes.end()}, why);
}

} // namespace pelorus
