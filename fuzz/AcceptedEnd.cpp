#include "fuzz/AcceptedEnd.h"

#include "platform/PropertyList.h"

#include <algorithm>

namespace pelorus::fuzz {

namespace {

constexpr std::size_t kHeaderLength = 13;

unsigned at(std::span<const std::byte> packet, std::size_t offset)
{
    return std::to_integer<unsigned>(packet[offset]);
}

} // namespace

AcceptedEnd acceptedEnd(std::string_view technology, std::span<const std::byte> message)
{
    if (message.size() < kHeaderLength || technology == "IFX" || technology == "Osprey CDMA")
        return AcceptedEnd::none;
    const auto packet = message.subspan(at(message, 0) == 0x81 ? 2 : 0);
    const unsigned code = at(packet, 3) | at(packet, 4) << 8;
    // Records that the packet does not hold: neighbours of both kinds, transport channels, coded channels.
    if (at(packet, 0) == 1 && technology == "Osprey UTRAN2" &&
        (code == 0xD00A || code == 0xD00C || code == 0xD00E))
        return AcceptedEnd::arrayOutOfBounds;
    // SIM files that cannot be read. Less than a header is left when the prefix is gone from the shortest
    // message.
    const auto list = packet.subspan(std::min(kHeaderLength, packet.size()));
    if (at(packet, 0) == 0xFF && code == 0 && !parsePropertyList(list))
        return AcceptedEnd::unknownData;
    return AcceptedEnd::none;
}

} // namespace pelorus::fuzz
