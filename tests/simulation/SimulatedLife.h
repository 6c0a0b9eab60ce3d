#pragma once

#include "telephonyd/simulation/Simulation.h"

#include <cstdint>
#include <string_view>

namespace pelorus::test {

/// A message of a simulated handset, read by offsets that the test spells itself.
class SeenMessage {
public:
    explicit SeenMessage(const SimulatedMessage& message) : content(message) {}

    std::uint32_t code() const { return content.code; }
    double seconds() const { return std::chrono::duration<double>(content.time).count(); }
    std::span<const std::byte> bytes() const { return content.bytes; }
    std::size_t size() const { return content.bytes.size(); }

    int u8(std::size_t offset) const { return std::to_integer<int>(content.bytes[offset]); }
    int s8(std::size_t offset) const { return static_cast<std::int8_t>(u8(offset)); }
    int u16(std::size_t offset) const { return u8(offset) | u8(offset + 1) << 8; }
    int s16(std::size_t offset) const { return static_cast<std::int16_t>(u16(offset)); }
    std::int64_t u32(std::size_t offset) const
    {
        return u16(offset) | static_cast<std::int64_t>(u16(offset + 2)) << 16;
    }

private:
    SimulatedMessage content;
};

constexpr HandsetTime kBirth = std::chrono::sys_days(std::chrono::year(2024) / 5 / 1);

/// Shows every message of a handset's first `duration` to `see`.
template <class See>
void watch(std::string_view technology, std::uint64_t seed, std::chrono::nanoseconds duration, See&& see)
{
    const auto simulation = Simulation::create(technology, seed, kBirth);
    SimulatedMessage message;
    for (simulation->next(message); message.time < duration; simulation->next(message))
        see(SeenMessage(message));
}

} // namespace pelorus::test
