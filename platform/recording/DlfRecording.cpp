#include "platform/recording/DlfRecording.h"

#include "platform/recording/RawMessages.h"

#include <algorithm>
#include <array>
#include <fmt/format.h>

namespace pelorus {

namespace {

constexpr std::byte kBasebandType{0x01}; // DLF keeps no type of its own
// A version report: 161 bytes of log code 0x1FFD.
constexpr std::array kVersionReportStart{std::byte{0xA1}, std::byte{0x00}, std::byte{0xFD}, std::byte{0x1F}};
constexpr std::size_t kVersionReportTime = 81; // 4 bytes, seconds since 1970

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

DlfRecording::DlfRecording(std::vector<std::byte> bytes) : content(std::move(bytes)), framing(content)
{
    std::uint32_t seconds = 0;
    for (std::size_t place = 0; place < 4; ++place)
        seconds |= std::to_integer<std::uint32_t>(content[kVersionReportTime + place]) << (8 * place);
    time = recordedTime(seconds);
}

RecordingReader::Next DlfRecording::next(RecordedMessage& message)
{
    if (offset == content.size())
        return Next::end;
    const auto before = framing.at(offset);
    const auto length = before ? recordLengthAt(content, offset + *before) : std::nullopt;
    if (!length) {
        reason = fmt::format("no whole log record at byte {} of {}", offset, content.size());
        return Next::failed;
    }
    const auto start = content.begin() + static_cast<std::ptrdiff_t>(offset + *before);
    current.assign(1, *before == 0 ? kBasebandType : start[-1]);
    current.insert(current.end(), start, start + static_cast<std::ptrdiff_t>(*length));
    message = {time, current};
    offset += *before + *length;
    return Next::message;
}

} // namespace pelorus
