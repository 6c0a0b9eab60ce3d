#pragma once

#include <cstddef>
#include <optional>
#include <span>

namespace pelorus {

constexpr std::size_t kRecordHeaderLength = 12; // of a log record: length, log code, time stamp

/// Length of the log record that begins at `offset`, by its first two bytes; nothing when it is no record, or
/// does not end within the bytes.
std::optional<std::size_t> recordLengthAt(std::span<const std::byte> bytes, std::size_t offset);

/// Length of the message at the start of a raw buffer of messages, one behind the other: a 2-byte prefix
/// where byte 0 is 0x81, the log type, the record. Nothing when it cannot be told.
std::optional<std::size_t> messageLength(std::span<const std::byte> bytes);

} // namespace pelorus
