#include "platform/XmlScanner.h"

#include "platform/XmlPropertyListText.h"

namespace pelorus {

bool XmlScanner::pass(std::string_view start)
{
    if (!at(start))
        return false;
    place += start.size();
    return true;
}

void XmlScanner::passSpace()
{
    while (!ended() && isXmlSpace(text[place]))
        ++place;
}

bool XmlScanner::passSpaceAndComments()
{
    for (passSpace(); pass("<!--"); passSpace())
        if (!passBehind("-->"))
            return false;
    return true;
}

bool XmlScanner::passBehind(std::string_view end)
{
    const std::size_t found = text.find(end, place);
    if (found == std::string_view::npos)
        return false;
    place = found + end.size();
    return true;
}

std::optional<std::string_view> XmlScanner::passUntil(std::string_view characters)
{
    const std::size_t start = place;
    const std::size_t found =
        characters.size() == 1 ? text.find(characters.front(), place) : text.find_first_of(characters, place);
    if (found == std::string_view::npos)
        return std::nullopt;
    place = found;
    return since(start);
}

XmlScanner::Outcome XmlScanner::passDocumentType()
{
    char quote = 0;
    for (; !ended(); ++place) {
        const char c = text[place];
        if (quote != 0) {
            if (c == quote)
                quote = 0;
        } else if (c == '"' || c == '\'') {
            quote = c;
        } else if (c == '[') {
            return Outcome::malformed;
        } else if (c == '>') {
            ++place;
            return Outcome::passed;
        }
    }
    return Outcome::ended;
}

XmlScanner::Outcome XmlScanner::readTag(Tag& tag)
{
    pass("<");
    tag.closing = pass("/");
    const std::size_t start = place;
    while (!ended() && text[place] >= 'a' && text[place] <= 'z')
        ++place;
    tag.name = since(start);
    passSpace();
    tag.empty = !tag.closing && pass("/");
    if (ended())
        return Outcome::ended;
    return !tag.name.empty() && pass(">") ? Outcome::passed : Outcome::malformed;
}

} // namespace pelorus
