#include "telephonyd/server/LogMessage.h"

namespace pelorus {

namespace {

constexpr std::size_t kHeaderLength = 13; // of the whole message, prefix included
constexpr std::byte kPrefix{0x81};
constexpr std::size_t kPrefixLength = 2;
constexpr std::byte kBaseband{1};
constexpr std::byte kTelephonyServer{0xFF};
constexpr std::size_t kLogCode = 3;

} // namespace

std::optional<std::uint32_t> logCodeOf(std::span<const std::byte> message)
{
    if (message.size() < kHeaderLength)
        return std::nullopt;
    if (message[0] == kPrefix)
        message = message.subspan(kPrefixLength);
    const auto code = std::to_integer<std::uint32_t>(message[kLogCode]) |
                      std::to_integer<std::uint32_t>(message[kLogCode + 1]) << 8;
    if (message[0] == kBaseband)
        return code;
    if (message[0] == kTelephonyServer)
        return code | 0xFF0000;
    return std::nullopt;
}

} // namespace pelorus
