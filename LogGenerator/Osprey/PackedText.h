#pragma once

#include <array>
#include <bit>
#include <cstdint>
#include <cstring>
#include <string>
#include <string_view>

namespace pelorus {

/// Up to 16 characters in two registers. A row is composed there and stored once: bytes that are stored one
/// by one and copied at once stall the processor longer than all of the formatting takes.
class PackedText {
public:
    static constexpr std::size_t capacity = 16;

    constexpr PackedText() = default;
    /// The first characters of a text that is too long for it are of no use; ask fits() first.
    constexpr explicit PackedText(std::string_view text)
    {
        for (const char character : text)
            append(static_cast<unsigned char>(character), 1);
    }
    static constexpr bool fits(std::string_view text) { return text.size() <= capacity; }

    constexpr unsigned length() const { return used; }

    /// `characters` holds `count` of them, at most 8, the first one lowest, zeros above. There must be room.
    constexpr void append(std::uint64_t characters, unsigned count)
    {
        if (used < 8) {
            low |= characters << (8 * used);
            if (used > 0)
                high |= characters >> (64 - 8 * used);
        } else {
            high |= characters << (8 * (used - 8));
        }
        used += count;
    }
    constexpr void append(const PackedText& text)
    {
        if (text.used == 0)
            return;
        append(text.low, text.used < 8 ? text.used : 8);
        if (text.used > 8)
            append(text.high, text.used - 8);
    }

    /// The decimal digits of a value below kDigitsEnd, without leading zeros.
    static constexpr std::uint32_t kDigitsEnd = 100'000'000;
    constexpr void appendNumber(std::uint32_t value)
    {
        if (value < 10'000)
            return appendSignificant<4>(four(value));
        appendSignificant<8>(four(value / 10'000) | four(value % 10'000) << 32);
    }
    /// A point and `value` as two digits; value below 100.
    constexpr void appendHundredths(std::uint32_t value) { append('.' | two(value) << 8, 3); }

    /// A point and `value` as six digits; value below 1,000,000.
    constexpr void appendMillionths(std::uint32_t value)
    {
        append('.' | two(value / 10'000) << 8 | two(value / 100 % 100) << 24 | two(value % 100) << 40, 7);
    }

    /// Makes `out` this text.
    void storeInto(std::string& out) const
    {
        out.resize(used);
        char* const place = out.data();
        if (used >= 8) {
            std::memcpy(place, &low, 8);
            const unsigned shift = 8 * (used - 8);
            const std::uint64_t tail = shift == 0    ? low
                                       : shift == 64 ? high
                                                     : low >> shift | high << (64 - shift);
            std::memcpy(place + used - 8, &tail, 8);
        } else if (used >= 4) {
            const auto head = static_cast<std::uint32_t>(low);
            const auto tail = static_cast<std::uint32_t>(low >> (8 * (used - 4)));
            std::memcpy(place, &head, 4);
            std::memcpy(place + used - 4, &tail, 4);
        } else {
            for (unsigned index = 0; index < used; ++index)
                place[index] = static_cast<char>(low >> (8 * index));
        }
    }

private:
    static_assert(std::endian::native == std::endian::little,
                  "the first character is the lowest byte of a word");

    static constexpr auto kPairs = [] {
        std::array<std::uint16_t, 100> pairs{};
        for (unsigned value = 0; value < pairs.size(); ++value)
            pairs[value] = static_cast<std::uint16_t>(('0' + value / 10) | ('0' + value % 10) << 8);
        return pairs;
    }();
    static constexpr std::uint64_t two(std::uint32_t value) { return kPairs[value]; }
    static constexpr std::uint64_t four(std::uint32_t value)
    {
        return two(value / 100) | two(value % 100) << 16;
    }

    template <unsigned count> constexpr void appendSignificant(std::uint64_t digits)
    {
        constexpr std::uint64_t kZeros = 0x3030303030303030 >> (64 - 8 * count);
        constexpr std::uint64_t kLastDigit = std::uint64_t{1}
                                             << (8 * count - 8); // ends the search at the last
        const unsigned leading = static_cast<unsigned>(std::countr_zero((digits ^ kZeros) | kLastDigit)) / 8;
        append(digits >> (8 * leading), count - leading);
    }

    std::uint64_t low = 0;
    std::uint64_t high = 0;
    unsigned used = 0;
};

} // namespace pelorus
