#include "platform/PrintableText.h"

#include "platform/Utf8.h"

#include <algorithm>
#include <fmt/format.h>

namespace pelorus {

namespace {

std::string escaped(unsigned char byte)
{
    return fmt::format("\\x{:02x}", byte);
}

} // namespace

std::string printable(std::string_view text)
{
    // Nearly all texts are plain.
    if (std::all_of(text.begin(), text.end(), [](char c) { return c >= 0x20 && c < 0x7F; }))
        return std::string(text);
    std::string shown;
    std::size_t validEnd = validUtf8Prefix(text);
    for (std::size_t place = 0; place < text.size(); ++place) {
        const auto byte = [text](std::size_t at) { return static_cast<unsigned char>(text[at]); };
        if (byte(place) == '\n') {
            shown += "\\n";
        } else if (place == validEnd) {
            shown += escaped(byte(place));
            validEnd += 1 + validUtf8Prefix(text.substr(place + 1));
        } else if (byte(place) < 0x20 || byte(place) == 0x7F) {
            shown += escaped(byte(place));
        } else if (byte(place) == 0xC2 && byte(place + 1) < 0xA0) { // to a terminal U+009B is what ESC [ is
            shown += escaped(byte(++place));
        } else {
            shown += text[place];
        }
    }
    return shown;
}

} // namespace pelorus
