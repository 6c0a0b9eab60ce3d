#include "platform/recording/RawMessages.h"

namespace pelorus {

std::optional<std::size_t> recordLengthAt(std::span<const std::byte> bytes, std::size_t offset)
{
    if (offset > bytes.size() || bytes.size() - offset < kRecordHeaderLength)
        return std::nullopt;
    const auto length =
        std::to_integer<std::size_t>(bytes[offset]) | std::to_integer<std::size_t>(bytes[offset + 1]) << 8;
    if (length < kRecordHeaderLength || length > bytes.size() - offset)
        return std::nullopt;
    return length;
}

std::optional<std::size_t> messageLength(std::span<const std::byte> bytes)
{
    const std::size_t framing = !bytes.empty() && bytes[0] == std::byte{0x81} ? 3 : 1;
    const auto record = recordLengthAt(bytes, framing);
    return record ? std::optional(framing + *record) : std::nullopt;
}

} // namespace pelorus
