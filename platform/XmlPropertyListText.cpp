#include "platform/XmlPropertyListText.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>

namespace pelorus {

using namespace std::literals;

namespace {

constexpr bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

std::string_view withoutSign(std::string_view text)
{
    return text.starts_with('-') || text.starts_with('+') ? text.substr(1) : text;
}

} // namespace

std::string_view trimmedXmlText(std::string_view text)
{
    while (!text.empty() && isXmlSpace(text.front()))
        text.remove_prefix(1);
    while (!text.empty() && isXmlSpace(text.back()))
        text.remove_suffix(1);
    return text;
}

/// libplist hands the digits to strtoull, which takes more than one sign and a leading zero for an octal
/// number.
bool isXmlInteger(std::string_view text)
{
    const std::uint64_t largest = text.starts_with('-') ? std::uint64_t{1} << 63 : ~std::uint64_t{0};
    text = withoutSign(text);
    const bool hexadecimal = text.starts_with("0x") || text.starts_with("0X");
    if (hexadecimal)
        text.remove_prefix(2);
    else if (text.size() > 1 && text.front() == '0')
        return false;
    std::uint64_t value = 0;
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, value, hexadecimal ? 16 : 10);
    return result.ec == std::errc() && result.ptr == end && value <= largest;
}

bool isXmlReal(std::string_view text)
{
    if (text.starts_with('+') && !text.starts_with("+-"))
        text.remove_prefix(1);
    double value = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), value);
    return result.ec != std::errc::invalid_argument && result.ptr == text.data() + text.size();
}

/// "2001-01-01T00:00:00Z". libplist writes early years without leading zeros.
bool isXmlDate(std::string_view text)
{
    const auto year = text.substr(0, text.find('-'));
    if (year.empty() || year.size() > 4 || !std::all_of(year.begin(), year.end(), isDigit))
        return false;
    text.remove_prefix(year.size());
    constexpr std::string_view shape = "-00-00T00:00:00Z";
    constexpr auto fits = [](char c, char example) { return example == '0' ? isDigit(c) : c == example; };
    if (!std::equal(text.begin(), text.end(), shape.begin(), shape.end(), fits))
        return false;
    const auto number = [text](std::size_t at) { return (text[at] - '0') * 10 + text[at + 1] - '0'; };
    const int month = number(1);
    const int day = number(4);
    return month >= 1 && month <= 12 && day >= 1 && day <= 31 && number(7) < 24 && number(10) < 60 &&
           number(13) <= 60;
}

/// libplist passes over what is no base64 digit and drops an incomplete last group.
bool isXmlData(std::string_view text)
{
    constexpr auto isBase64Digit = [](char c) {
        return isDigit(c) || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == '+' || c == '/';
    };
    std::size_t digits = 0;
    std::size_t padding = 0;
    for (const char c : text) {
        if (c == '=')
            ++padding;
        else if (isBase64Digit(c) && padding == 0)
            ++digits;
        else if (!isXmlSpace(c))
            return false;
    }
    return padding <= 2 && (digits + padding) % 4 == 0;
}

/// One that libplist reads right: it looks at the first letters only.
bool isXmlEntity(std::string_view name)
{
    if (!name.starts_with('#'))
        return name == "amp" || name == "lt" || name == "gt" || name == "quot" || name == "apos";
    const bool hexadecimal = name.starts_with("#x") || name.starts_with("#X");
    if (name.size() > 8)
        return false;
    name.remove_prefix(hexadecimal ? 2 : 1);
    std::uint32_t character = 0;
    const auto result =
        std::from_chars(name.data(), name.data() + name.size(), character, hexadecimal ? 16 : 10);
    return result.ec == std::errc() && result.ptr == name.data() + name.size() && character != 0 &&
           character <= 0x10FFFF && (character < 0xD800 || character > 0xDFFF);
}

/// Whether the XML declaration allows reading the text as UTF-8, which libplist does in any case.
bool declaresUtf8(std::string_view declaration)
{
    const std::size_t attribute = declaration.find("encoding");
    if (attribute == std::string_view::npos)
        return true;
    const std::size_t quote = declaration.find_first_of("\"'", attribute);
    if (quote == std::string_view::npos)
        return false;
    const auto name =
        declaration.substr(quote + 1, declaration.find(declaration[quote], quote + 1) - quote - 1);
    constexpr auto sameLetter = [](char a, char b) {
        return (a >= 'a' && a <= 'z' ? a - 'a' + 'A' : a) == b;
    };
    constexpr std::array accepted{"UTF-8"sv, "UTF8"sv, "US-ASCII"sv, "ASCII"sv};
    return std::any_of(accepted.begin(), accepted.end(), [name, sameLetter](std::string_view one) {
        return std::equal(name.begin(), name.end(), one.begin(), one.end(), sameLetter);
    });
}

} // namespace pelorus
