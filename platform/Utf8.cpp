#include "platform/Utf8.h"

namespace pelorus {

namespace {

/// Length of the character at the start of a text that is not empty; 0 if there is none.
std::size_t characterLength(std::string_view text)
{
    const auto byte = [text](std::size_t i) { return static_cast<unsigned char>(text[i]); };
    const unsigned lead = byte(0);
    if (lead < 0x80)
        return lead != 0 ? 1 : 0;
    const std::size_t length = lead < 0xC2 ? 0 : lead < 0xE0 ? 2 : lead < 0xF0 ? 3 : lead < 0xF5 ? 4 : 0;
    if (length == 0 || text.size() < length)
        return 0;
    for (std::size_t i = 1; i < length; ++i)
        if ((byte(i) & 0xC0) != 0x80)
            return 0;
    const unsigned second = byte(1);
    const bool overlong = (lead == 0xE0 && second < 0xA0) || (lead == 0xF0 && second < 0x90);
    const bool surrogate = lead == 0xED && second >= 0xA0;
    const bool beyond = lead == 0xF4 && second >= 0x90;
    return overlong || surrogate || beyond ? 0 : length;
}

constexpr char32_t kReplacement = 0xFFFD;

bool isLeading(char32_t unit)
{
    return unit >= 0xD800 && unit < 0xDC00;
}

bool isTrailing(char32_t unit)
{
    return unit >= 0xDC00 && unit < 0xE000;
}

void append(std::string& out, char32_t character)
{
    const auto put = [&out](char32_t byte) { out += static_cast<char>(byte); };
    const auto putRest = [&](unsigned shift) { put(0x80 | ((character >> shift) & 0x3F)); };
    if (character < 0x80) {
        put(character);
    } else if (character < 0x800) {
        put(0xC0 | character >> 6);
        putRest(0);
    } else if (character < 0x10000) {
        put(0xE0 | character >> 12);
        putRest(6);
        putRest(0);
    } else {
        put(0xF0 | character >> 18);
        putRest(12);
        putRest(6);
        putRest(0);
    }
}

} // namespace

std::size_t validUtf8Prefix(std::string_view text)
{
    std::size_t valid = 0;
    while (valid < text.size()) {
        const std::size_t length = characterLength(text.substr(valid));
        if (length == 0)
            break;
        valid += length;
    }
    return valid;
}

void utf8FromUtf16(std::string_view bigEndian, std::string& out)
{
    const std::size_t count = bigEndian.size() / 2;
    const auto unit = [bigEndian](std::size_t index) -> char32_t {
        const auto byte = [bigEndian](std::size_t i) { return static_cast<unsigned char>(bigEndian[i]); };
        return static_cast<char32_t>(byte(2 * index) << 8 | byte(2 * index + 1));
    };
    out.clear();
    for (std::size_t index = 0; index < count; ++index) {
        const char32_t first = unit(index);
        if (isLeading(first) && index + 1 < count && isTrailing(unit(index + 1)))
            append(out, 0x10000 + ((first - 0xD800) << 10) + (unit(++index) - 0xDC00));
        else
            append(out, isLeading(first) || isTrailing(first) ? kReplacement : first);
    }
}

} // namespace pelorus
