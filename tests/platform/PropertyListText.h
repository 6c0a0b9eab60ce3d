#pragma once

#include "platform/PropertyList.h"

#include <span>
#include <string>
#include <string_view>

namespace pelorus {

inline std::span<const std::byte> bytesOf(std::string_view text)
{
    return std::as_bytes(std::span(text));
}

inline Value parsed(std::string_view text, std::string* why = nullptr)
{
    return parsePropertyList(bytesOf(text), why);
}

/// The line that says why a list cannot be read; empty when it can.
inline std::string refusal(std::string_view text)
{
    std::string why;
    return parsed(text, &why) ? std::string() : why;
}

/// Empty when the value cannot be written.
inline std::string serialized(const Value& value, PropertyListForm form)
{
    const auto bytes = serializePropertyList(value, form);
    return bytes ? std::string(reinterpret_cast<const char*>(bytes->data()), bytes->size()) : std::string();
}

inline constexpr std::string_view kXmlHeader = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
                                               "<!DOCTYPE plist PUBLIC \"-//Example//DTD PLIST 1.0//EN\" "
                                               "\"http://example.com/PropertyList-1.0.dtd\">\n"
                                               "<plist version=\"1.0\">\n";

inline Date dateAt(std::int64_t secondsSince1970, std::int64_t microseconds = 0)
{
    return Date(std::chrono::microseconds(secondsSince1970 * 1'000'000 + microseconds));
}

} // namespace pelorus
