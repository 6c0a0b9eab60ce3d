#pragma once

#include <algorithm>
#include <fmt/format.h>
#include <string>
#include <string_view>

namespace pelorus::test {

/// "%p" in place of every address.
inline std::string withoutAddresses(std::string_view line)
{
    std::string text;
    for (std::size_t place = line.find("0x"); place != std::string_view::npos; place = line.find("0x")) {
        text += line.substr(0, place);
        text += "%p";
        line.remove_prefix(place + 2);
        line.remove_prefix(std::min(line.find_first_not_of("0123456789abcdef"), line.size()));
    }
    text += line;
    return text;
}

/// A property list in XML around its content.
inline std::string propertyListText(std::string_view content)
{
    return fmt::format("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\">{}</plist>\n",
                       content);
}

} // namespace pelorus::test
