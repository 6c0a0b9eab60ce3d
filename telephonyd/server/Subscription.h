#pragma once

#include "platform/Value.h"

#include <bitset>
#include <span>

namespace pelorus {

/// The messages that a client asked for.
class Subscription {
public:
    /// Nothing when that is no start command; `why` is then one line.
    static std::optional<Subscription> fromStartCommand(const Value& command, std::string& why);
    static Subscription toEverything();

    bool wants(std::span<const std::byte> message) const;
    bool wants(std::uint32_t code) const;
    /// In words.
    std::string description() const;

private:
    static constexpr std::size_t kCodes = 0x10000;

    bool everything = false;
    std::bitset<kCodes> basebandCodes;
    std::bitset<kCodes> serverCodes; // less 0xFF0000
};

} // namespace pelorus
