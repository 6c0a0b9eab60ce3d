#include "platform/recording/Recording.h"

#include "platform/PropertyList.h"
#include "platform/recording/DlfRecording.h"
#include "platform/recording/PcapRecording.h"
#include "platform/recording/SnapshotRecording.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <fmt/format.h>
#include <iterator>
#include <optional>

namespace pelorus {

namespace {

constexpr std::array<unsigned char, 4> kPcapMagics[] = {
    {0xD4, 0xC3, 0xB2, 0xA1}, {0xA1, 0xB2, 0xC3, 0xD4}, // microseconds
    {0x4D, 0x3C, 0xB2, 0xA1}, {0xA1, 0xB2, 0x3C, 0x4D}, // nanoseconds
    {0x0A, 0x0D, 0x0D, 0x0A},                           // pcapng
};

constexpr std::size_t kLongestMark = 512; // blanks before a snapshot's first tag included
constexpr std::size_t kLongestFile = PropertyListLimits::input;

bool isPcap(std::span<const std::byte> start)
{
    return start.size() >= 4 &&
           std::any_of(std::begin(kPcapMagics), std::end(kPcapMagics), [start](const auto& magic) {
               return std::memcmp(magic.data(), start.data(), magic.size()) == 0;
           });
}

/// Reads on until the file ends or `most` bytes are read. Nothing, and `why`, when that fails.
std::optional<std::vector<std::byte>> read(std::FILE* file, std::size_t most, std::string& why)
{
    std::vector<std::byte> bytes;
    std::size_t length = 0;
    while (length < most) {
        bytes.resize(std::min(most, std::max<std::size_t>(2 * length, 4096)));
        const std::size_t count = std::fread(bytes.data() + length, 1, bytes.size() - length, file);
        length += count;
        if (length < bytes.size()) {
            if (std::ferror(file)) {
                why = std::strerror(errno);
                return std::nullopt;
            }
            break;
        }
    }
    bytes.resize(length);
    return bytes;
}

} // namespace

RecordedTime recordedTime(std::int64_t seconds, std::int64_t nanoseconds)
{
    constexpr std::int64_t kFarthest = 8'000'000'000;
    constexpr std::int64_t kLastOfASecond = 999'999'999;
    return RecordedTime(std::chrono::seconds(std::clamp(seconds, -kFarthest, kFarthest)) +
                        std::chrono::nanoseconds(std::clamp(nanoseconds, std::int64_t{0}, kLastOfASecond)));
}

std::unique_ptr<RecordingReader> RecordingReader::open(const std::string& path, std::string& why)
{
    PcapRecording::File file(std::fopen(path.c_str(), "rbe"), std::fclose);
    if (!file) {
        why = std::strerror(errno);
        return nullptr;
    }
    const auto head = read(file.get(), kLongestMark, why);
    if (!head)
        return nullptr;
    if (head->empty()) {
        why = "the file is empty";
        return nullptr;
    }
    const bool isSnapshot = SnapshotRecording::looksLikeOne(*head);
    if (!isSnapshot && !isPcap(*head) && !DlfRecording::looksLikeOne(*head)) {
        why = "no recording: neither pcap or pcapng, nor a snapshot, nor a DLF file";
        return nullptr;
    }
    const bool seeks = fseeko(file.get(), 0, SEEK_END) == 0;
    const off_t length = ftello(file.get());
    if (!seeks || fseeko(file.get(), 0, SEEK_SET) != 0) {
        why = "no file that can be read twice";
        return nullptr;
    }
    if (isPcap(*head))
        return PcapRecording::open(std::move(file), why);
    if (length > off_t{kLongestFile}) {
        why = fmt::format("{} bytes, too long for a {}", length, isSnapshot ? "snapshot" : "DLF file");
        return nullptr;
    }
    auto content = read(file.get(), kLongestFile, why);
    if (!content)
        return nullptr;
    return isSnapshot ? SnapshotRecording::open(*content, why) : DlfRecording::open(std::move(*content), why);
}

} // namespace pelorus
