#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace pelorus::fuzz {

/// A fuzzer's input, taken from the front. Beyond its end there are zeros, and nothing to take.
class Input {
public:
    Input(const std::uint8_t* data, std::size_t size) : bytes(std::as_bytes(std::span(data, size))) {}

    bool empty() const { return bytes.empty(); }
    std::uint8_t byte()
    {
        const auto first = take(1);
        return first.empty() ? std::uint8_t{0} : std::to_integer<std::uint8_t>(first.front());
    }
    std::size_t word() // little-endian
    {
        const std::size_t low = byte();
        return low | std::size_t{byte()} << 8;
    }
    std::span<const std::byte> take(std::size_t length)
    {
        const auto taken = bytes.first(std::min(length, bytes.size()));
        bytes = bytes.subspan(taken.size());
        return taken;
    }
    /// In memory of their own size, so that the address sanitizer sees what is read beyond them.
    std::vector<std::byte> copy(std::size_t length)
    {
        const auto taken = take(length);
        return {taken.begin(), taken.end()};
    }

private:
    std::span<const std::byte> bytes;
};

} // namespace pelorus::fuzz
