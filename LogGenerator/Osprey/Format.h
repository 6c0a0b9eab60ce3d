#pragma once

#include <algorithm>
#include <array>
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
    static constexpr std::size_t kRoom = 16;
    struct Affix {
        std::array<char, kRoom> text{}; // copied whole, which is cheaper than counting
        std::size_t length = 0;

        consteval void set(std::string_view given)
        {
            if (given.size() > kRoom)
                throw "a text that is too long";
            std::copy(given.begin(), given.end(), text.begin());
            length = given.size();
        }
    };

    consteval explicit Format(std::string_view text)
    {
        const std::size_t percent = text.find('%');
        const std::size_t end = text.find_first_of("duf", percent) + 1;
        const std::string_view conversion = text.substr(percent, end - percent);
        if (conversion != "%d" && conversion != "%u" && conversion != "%4.2f" && conversion != "%f")
            throw "a conversion that rows do not use";
        isUnsigned = conversion == "%u";
        hasSixDecimals = conversion == "%f";
        prefix.set(text.substr(0, percent));
        suffix.set(text.substr(end));
    }

    Affix prefix;
    Affix suffix;
    bool isUnsigned = false;
    bool hasSixDecimals = false;

    class Text;
};

} // namespace pelorus
