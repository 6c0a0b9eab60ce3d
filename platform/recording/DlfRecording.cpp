#include "platform/recording/DlfRecording.h"

#include "platform/recording/RawMessages.h"

#include <algorithm>
#include <array>
#include <fmt/format.h>
#include <tuple>

namespace pelorus {

namespace {

constexpr std::byte kBaseband{0x01};
constexpr std::byte kInternal{0xFF};
constexpr std::byte kPrefix{0x81};
// A version report: 161 bytes of log code 0x1FFD.
constexpr std::array kVersionReportStart{std::byte{0xA1}, std::byte{0x00}, std::byte{0xFD}, std::byte{0x1F}};
constexpr std::size_t kVersionReportTime = 81; // 4 bytes, seconds since 1970
// What may stand before a record: nothing, the log type, that and what is left of the prefix, or the whole
// prefix.
constexpr std::size_t kLongestFraming = 3;
constexpr int kLookAhead = 4;

} // namespace

bool DlfRecording::looksLikeOne(std::span<const std::byte> start)
{
    return start.size() >= kVersionReportStart.size() &&
           std::equal(kVersionReportStart.begin(), kVersionReportStart.end(), start.begin());
}

std::unique_ptr<RecordingReader> DlfRecording::open(std::vector<std::byte> content, std::string& why)
{
    if (!recordLengthAt(content, 0)) {
        why = fmt::format("a DLF file whose version report is cut short, {} bytes", content.size());
        return nullptr;
    }
    return std::unique_ptr<RecordingReader>(new DlfRecording(std::move(content)));
}

DlfRecording::DlfRecording(std::vector<std::byte> bytes) : content(std::move(bytes)), plain(isPlainSequence())
{
    std::uint32_t seconds = 0;
    for (std::size_t place = 0; place < 4; ++place)
        seconds |= std::to_integer<std::uint32_t>(content[kVersionReportTime + place]) << (8 * place);
    time = RecordedTime(std::chrono::seconds(seconds));
}

bool DlfRecording::isPlainSequence() const
{
    std::size_t place = 0;
    while (const auto length = recordLengthAt(content, place))
        place += *length;
    return place == content.size();
}

bool DlfRecording::hasFraming(std::size_t place, std::size_t length) const
{
    if (length == 0)
        return true;
    if (length > content.size() - place)
        return false;
    const std::byte type = content[place + length - 1];
    return (type == kBaseband || type == kInternal) &&
           (length < kLongestFraming || content[place] == kPrefix);
}

DlfRecording::Outlook DlfRecording::outlook(std::size_t place, std::size_t framing, int depth) const
{
    const auto length = recordLengthAt(content, place + framing);
    if (!length || !hasFraming(place, framing))
        return {};
    const int isPlain = framing == 0 ? 1 : 0;
    const std::size_t next = place + framing + *length;
    if (depth == 0)
        return {1, isPlain};
    if (next == content.size())
        return {1 + depth, isPlain}; // as good as any
    Outlook best{0, 0};
    for (std::size_t follow = 0; follow <= kLongestFraming; ++follow) {
        const Outlook rest = outlook(next, follow, depth - 1);
        if (std::tuple(-rest.records, rest.plainRecords) < std::tuple(-best.records, best.plainRecords))
            best = rest;
    }
    return {1 + best.records, isPlain + best.plainRecords};
}

std::size_t DlfRecording::bestFraming(std::size_t place) const
{
    std::size_t best = 0;
    Outlook most;
    for (std::size_t framing = 0; framing <= kLongestFraming; ++framing) {
        const Outlook candidate = outlook(place, framing, kLookAhead);
        if (std::tuple(-candidate.records, candidate.plainRecords) <
            std::tuple(-most.records, most.plainRecords)) {
            most = candidate;
            best = framing;
        }
    }
    return best;
}

RecordingReader::Next DlfRecording::next(RecordedMessage& message)
{
    if (offset == content.size())
        return Next::end;
    const std::size_t framing = plain ? 0 : bestFraming(offset);
    const auto length = recordLengthAt(content, offset + framing);
    if (!length) {
        reason = fmt::format("no whole log record at byte {} of {}", offset, content.size());
        return Next::failed;
    }
    const auto start = content.begin() + static_cast<std::ptrdiff_t>(offset + framing);
    current.assign(1, framing == 0 ? kBaseband : start[-1]);
    current.insert(current.end(), start, start + static_cast<std::ptrdiff_t>(*length));
    message = {time, current};
    offset += framing + *length;
    return Next::message;
}

} // namespace pelorus
