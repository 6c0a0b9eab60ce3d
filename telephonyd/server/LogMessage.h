#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>

namespace pelorus {

/// The log code of a message as it goes over the log channel, 0xFF0000 and up for the telephony server's own.
/// Nothing when it cannot be read: shorter than a header, or neither of the two log types.
std::optional<std::uint32_t> logCodeOf(std::span<const std::byte> message);

} // namespace pelorus
