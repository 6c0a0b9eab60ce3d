#pragma once

#include "LogGenerator/Osprey/PackedText.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace pelorus {

/// A printf text with one conversion, taken apart when the program is compiled so that
/// writing a row costs no parsing. Of the conversions it knows those that rows use: "%d", "%u", "%4.2f" and
/// "%f".
class Format {
public:
    // NOLINTNEXTLINE(google-explicit-constructor): tables read better with the bare printf text
    template <std::size_t N>
    consteval Format(const char (&literal)[N]) : Format(std::string_view(literal, N - 1))
    {}

    /// Replaces `out` by the text of an integer: "%d" prints its low 32 bits as signed, "%u" as unsigned.
    void write(std::string& out, std::int64_t value) const;
    /// One in the fixed-point numbers that writeFixed() takes.
    static constexpr std::int64_t kOne = 100'000'000;
    /// Replaces `out` by the text of value / kOne. Halves round to even, as printf does with a double that
    /// holds the same number exactly.
    void writeFixed(std::string& out, std::int64_t value) const;

private:
    consteval explicit Format(std::string_view text)
    {
        const std::size_t percent = text.find('%');
        const std::size_t end = text.find_first_of("duf", percent) + 1;
        const std::string_view conversion = text.substr(percent, end - percent);
        if (conversion != "%d" && conversion != "%u" && conversion != "%4.2f" && conversion != "%f")
            throw "a conversion that rows do not use";
        if (!PackedText::fits(text.substr(0, percent)) || !PackedText::fits(text.substr(end)))
            throw "a text that is too long";
        isUnsigned = conversion == "%u";
        hasSixDecimals = conversion == "%f";
        prefix = PackedText(text.substr(0, percent));
        suffix = PackedText(text.substr(end));
    }

    /// Whether the texts around a number of so many characters leave it room in a packed text.
    bool leavesRoomFor(unsigned characters) const
    {
        return prefix.length() + characters + suffix.length() <= PackedText::capacity;
    }
    void writeLong(std::string& out, std::string_view number) const;

    PackedText prefix;
    PackedText suffix;
    bool isUnsigned = false;
    bool hasSixDecimals = false;
};

} // namespace pelorus
