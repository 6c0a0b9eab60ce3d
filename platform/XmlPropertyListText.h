#pragma once

#include <string_view>

namespace pelorus {

// The texts of XML property lists, as far as libplist 2.2.0 reads them as they are meant. Everything else is
// false: libplist itself takes almost anything and makes something of it.

constexpr bool isXmlSpace(char c)
{
    return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

/// Without the white space at both ends.
std::string_view trimmedXmlText(std::string_view text);

bool isXmlInteger(std::string_view text);
bool isXmlReal(std::string_view text);
bool isXmlDate(std::string_view text);
bool isXmlData(std::string_view text);

/// An entity's name, without "&" and ";".
bool isXmlEntity(std::string_view name);

/// Whether an XML declaration ("<?xml ... ?>") allows reading the text as UTF-8, which libplist does in any
/// case.
bool declaresUtf8(std::string_view declaration);

} // namespace pelorus
