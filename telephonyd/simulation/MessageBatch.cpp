#include "telephonyd/simulation/MessageBatch.h"

namespace pelorus {

namespace {

// The header of every packet; the time stamp is 8 bytes long, two fields.
constexpr Field kLogType = u8(0);
constexpr Field kRecordLength = u16(1); // of what follows the log type
constexpr Field kLogCode = u16(3);
constexpr Field kTimeStampLow = u32(5);
constexpr Field kTimeStampHigh = u32(9);
constexpr std::size_t kHeaderLength = 13;
static_assert(kTimeStampHigh.end() == kHeaderLength);

constexpr int kBaseband = 1;
constexpr int kTelephonyServer = 0xFF;
constexpr std::uint32_t kInternalCodes = 0xFF0000;

} // namespace

std::size_t MessageBatch::append(std::uint32_t code, std::size_t length)
{
    const std::size_t first = messages.empty() ? 0 : messages.back().start + messages.back().length;
    bytes.resize(first); // the slack behind the last message may be written to
    bytes.resize(first + length + PacketWriter::kSlack);
    messages.push_back({now, code, first, length});
    return first;
}

std::size_t MessageBatch::begin(std::uint32_t code, std::size_t length)
{
    const std::size_t first = append(code, length);
    PacketWriter header(bytes, first);
    const std::uint64_t stamp = logTime(start + now);
    header.put(kLogType, code < kInternalCodes ? kBaseband : kTelephonyServer);
    header.put(kRecordLength, static_cast<std::int64_t>(length - 1));
    header.put(kLogCode, code & 0xFFFF);
    header.put(kTimeStampLow, static_cast<std::int64_t>(stamp & 0xFFFFFFFF));
    header.put(kTimeStampHigh, static_cast<std::int64_t>(stamp >> 32));
    return first;
}

PacketWriter MessageBatch::packet(std::uint16_t code, std::size_t length)
{
    return {bytes, begin(code, length)};
}

void MessageBatch::list(std::uint32_t code, std::span<const std::byte> propertyList)
{
    const std::size_t first = begin(code, kHeaderLength + propertyList.size());
    std::copy(propertyList.begin(), propertyList.end(),
              bytes.begin() + static_cast<std::ptrdiff_t>(first + kHeaderLength));
}

void MessageBatch::bare(std::span<const std::byte> content)
{
    const std::size_t first = append(0, content.size());
    std::copy(content.begin(), content.end(), bytes.begin() + static_cast<std::ptrdiff_t>(first));
}

SimulatedMessage MessageBatch::operator[](std::size_t index) const
{
    const Entry& entry = messages[index];
    return {entry.time, entry.code, std::span(bytes).subspan(entry.start, entry.length)};
}

void MessageBatch::clear()
{
    bytes.clear();
    messages.clear();
}

} // namespace pelorus
