#pragma once

#include <cstddef>
#include <span>
#include <string_view>

namespace pelorus::fuzz {

/// How a message may end the program. There is no other accepted way: whatever else is thrown is a finding.
enum class AcceptedEnd { none, arrayOutOfBounds, unknownData };

/// The end that a technology's generator may come to with that message.
AcceptedEnd acceptedEnd(std::string_view technology, std::span<const std::byte> message);

} // namespace pelorus::fuzz
