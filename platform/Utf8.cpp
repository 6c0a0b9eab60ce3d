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

} // namespace pelorus
