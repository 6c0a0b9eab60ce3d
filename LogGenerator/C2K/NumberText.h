#pragma once

#include "LogGenerator/Osprey/PackedText.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace pelorus {

/// A printf text with one conversion, taken apart when the program is compiled: "%d", "%+d" or "%06x" of an
/// integer's low 32 bits, "%.2f" or "%+.2f" of a double. Behind the conversion "%%" is a percent sign.
class NumberText {
public:
    // NOLINTNEXTLINE(google-explicit-constructor): tables read better with the bare printf text
    template <std::size_t N>
    consteval NumberText(const char (&literal)[N]) : NumberText(std::string_view(literal, N - 1))
    {}

    /// Replaces `out` by the text of a number.
    void write(std::string& out, std::int64_t value) const;
    void write(std::string& out, double value) const;

private:
    consteval explicit NumberText(std::string_view text)
    {
        const std::size_t percent = text.find('%');
        const std::size_t end = text.find_first_of("dfx", percent) + 1;
        const std::string_view conversion = text.substr(percent, end - percent);
        if (conversion != "%d" && conversion != "%+d" && conversion != "%06x" && conversion != "%.2f" &&
            conversion != "%.02f" && conversion != "%+.2f")
            throw "a conversion that rows do not use";
        showsPlus = conversion[1] == '+';
        isHexadecimal = conversion == "%06x";
        before = text.substr(0, percent);
        after = text.substr(end);
        if (after.starts_with("%%"))
            after.remove_prefix(1);
        isPacked = kPackedNumber + after.size() <= PackedText::capacity;
        if (isPacked)
            packedAfter = PackedText(after);
    }

    /// Numbers that end below this one are composed in a packed text, where what follows leaves them room.
    static constexpr std::uint32_t kPackedEnd = 10'000;
    static constexpr std::size_t kPackedNumber = std::string_view("-9999.99").size();

    std::string_view signOf(bool negative) const { return negative ? "-" : showsPlus ? "+" : ""; }
    void finish(std::string& out, PackedText number) const;
    void writeAround(std::string& out, std::string_view number) const;

    std::string_view before;
    std::string_view after;
    PackedText packedAfter;
    bool isPacked = false;
    bool showsPlus = false;
    bool isHexadecimal = false;
};

} // namespace pelorus
