#include "platform/PropertyListGuard.h"
#include "platform/XmlPropertyListText.h"

#include <fmt/format.h>

#include <array>

namespace pelorus {

namespace {

using namespace std::literals;

/// A strict scanner. Where libplist's own reading and XML differ, neither is taken: the text is refused.
class XmlPropertyListGuard {
public:
    XmlPropertyListGuard(std::string_view text, std::string& why) : text(text), why(why) {}

    std::optional<std::string_view> rootElement();

private:
    struct Tag {
        std::string_view name;
        bool closing;
        bool empty;
    };

    struct Container {
        bool dictionary;
        bool awaitsValue; // its last element was a key
        std::uint64_t keys;
        std::uint64_t keyBytes;

        std::string_view name() const { return dictionary ? "dict" : "array"; }
    };

    bool refuse(std::string reason)
    {
        why = std::move(reason);
        return false;
    }
    bool endsEarly();
    std::string_view rest() const { return text.substr(position); }
    bool at(std::string_view start) const { return rest().starts_with(start); }
    bool passBehind(std::string_view end);
    void passSpace();
    bool passSpaceAndComments();
    bool passProlog();
    bool passDocumentType();
    bool openWrapper(bool& wrapped);
    bool passTrailer(bool wrapped);
    bool readTag(Tag& tag);
    bool passRootElement();
    bool passElement(const Tag& tag);
    bool closeContainer(const Tag& tag);
    bool passScalar(const Tag& tag);
    bool passString(const Tag& tag, std::size_t& length);
    bool passTextPart(std::string_view part);
    bool passEndOf(std::string_view name);

    std::string_view text;
    std::string& why;
    std::size_t position = 0;
    PropertyListBudget budget;
    std::size_t depth = 0;
    std::string_view scalar; // the element whose text is being read
    std::array<Container, PropertyListLimits::depth> open;
};

std::optional<std::string_view> XmlPropertyListGuard::rootElement()
{
    bool wrapped = false;
    if (at("\xEF\xBB\xBF"))
        position = 3;
    if (!passProlog() || !openWrapper(wrapped) || !passSpaceAndComments())
        return std::nullopt;
    const std::size_t start = position;
    if (!passRootElement())
        return std::nullopt;
    const std::string_view root = text.substr(start, position - start);
    if (!passTrailer(wrapped))
        return std::nullopt;
    if (root.find('\0') != std::string_view::npos) {
        why = "the XML property list holds a NUL";
        return std::nullopt;
    }
    return root;
}

bool XmlPropertyListGuard::endsEarly()
{
    if (!scalar.empty())
        return refuse(fmt::format("the XML property list ends inside <{}>", scalar));
    if (depth > 0)
        return refuse(fmt::format("the XML property list ends inside <{}>", open[depth - 1].name()));
    return refuse("the XML property list ends before its value does");
}

bool XmlPropertyListGuard::passBehind(std::string_view end)
{
    const std::size_t found = text.find(end, position);
    if (found == std::string_view::npos)
        return endsEarly();
    position = found + end.size();
    return true;
}

void XmlPropertyListGuard::passSpace()
{
    while (position < text.size() && isXmlSpace(text[position]))
        ++position;
}

bool XmlPropertyListGuard::passSpaceAndComments()
{
    for (passSpace(); at("<!--"); passSpace()) {
        position += 4;
        if (!passBehind("-->"))
            return false;
    }
    return true;
}

bool XmlPropertyListGuard::passProlog()
{
    while (passSpaceAndComments()) {
        if (at("<?")) {
            const std::size_t start = position;
            if (!passBehind("?>"))
                return false;
            const std::string_view instruction = text.substr(start, position - start);
            if (instruction.starts_with("<?xml ") && !declaresUtf8(instruction))
                return refuse("the XML property list is not in UTF-8");
        } else if (at("<!DOCTYPE")) {
            if (!passDocumentType())
                return false;
        } else {
            return true;
        }
    }
    return false;
}

bool XmlPropertyListGuard::passDocumentType()
{
    char quote = 0;
    for (; position < text.size(); ++position) {
        const char c = text[position];
        if (quote != 0) {
            if (c == quote)
                quote = 0;
        } else if (c == '"' || c == '\'') {
            quote = c;
        } else if (c == '[') {
            return refuse("the XML property list has document type declarations of its own");
        } else if (c == '>') {
            ++position;
            return true;
        }
    }
    return endsEarly();
}

bool XmlPropertyListGuard::openWrapper(bool& wrapped)
{
    constexpr std::string_view start = "<plist";
    wrapped = at(start);
    if (!wrapped)
        return true;
    position += start.size();
    const std::size_t end = text.find_first_of("<>", position);
    if (end == std::string_view::npos)
        return endsEarly();
    const std::string_view attributes = text.substr(position, end - position);
    if (text[end] != '>' ||
        (!attributes.empty() && (!isXmlSpace(attributes.front()) || attributes.back() == '/')))
        return refuse("the XML property list has a malformed <plist>");
    position = end + 1;
    return true;
}

/// Behind the list only comments may follow, and NULs, which those that send texts with their terminator add.
bool XmlPropertyListGuard::passTrailer(bool wrapped)
{
    Tag tag;
    if (wrapped) {
        if (!passSpaceAndComments())
            return false;
        if (position == text.size())
            return refuse("the XML property list ends inside <plist>");
        if (!at("</plist"))
            return refuse("the XML property list holds more than one value");
        if (!readTag(tag))
            return false;
    }
    while (passSpaceAndComments()) {
        if (position == text.size())
            return true;
        if (text[position] != '\0')
            return refuse("something follows the XML property list");
        ++position;
    }
    return false;
}

bool XmlPropertyListGuard::readTag(Tag& tag)
{
    if (position == text.size())
        return endsEarly();
    if (text[position] != '<')
        return refuse(depth > 0 ? fmt::format("the XML property list has text between the elements of <{}>",
                                              open[depth - 1].name())
                                : std::string("the bytes are no property list"));
    ++position;
    tag.closing = at("/");
    position += tag.closing ? 1 : 0;
    const std::size_t start = position;
    while (position < text.size() && text[position] >= 'a' && text[position] <= 'z')
        ++position;
    tag.name = text.substr(start, position - start);
    passSpace();
    tag.empty = !tag.closing && at("/");
    position += tag.empty ? 1 : 0;
    if (position == text.size())
        return endsEarly();
    if (tag.name.empty() || tag.name.size() > 8 || text[position] != '>')
        return refuse(fmt::format("the XML property list has a malformed tag behind {} bytes", start));
    ++position;
    return true;
}

bool XmlPropertyListGuard::passRootElement()
{
    do {
        Tag tag;
        if (!passSpaceAndComments() || !readTag(tag))
            return false;
        if (!(tag.closing ? closeContainer(tag) : passElement(tag)))
            return false;
    } while (depth > 0);
    return true;
}

bool XmlPropertyListGuard::passElement(const Tag& tag)
{
    Container* parent = depth > 0 ? &open[depth - 1] : nullptr;
    const bool isKey = tag.name == "key";
    if (isKey != (parent && parent->dictionary && !parent->awaitsValue))
        return refuse(fmt::format("the XML property list has <{}> in the place of a {}", tag.name,
                                  isKey ? "value" : "key"));
    if (!budget.takeValue(why))
        return false;
    if (isKey) {
        std::size_t length = 0;
        if (tag.empty)
            return refuse("the XML property list has an empty <key/>"); // libplist takes it for a value
        if (!passString(tag, length))
            return false;
        parent->awaitsValue = true;
        ++parent->keys;
        parent->keyBytes += length;
        return true;
    }
    if (parent)
        parent->awaitsValue = false;
    if (tag.name != "array" && tag.name != "dict")
        return passScalar(tag);
    if (!budget.allowsDepth(depth + 1, why))
        return false;
    if (!tag.empty)
        open[depth++] = {tag.name == "dict", false, 0, 0};
    return true;
}

bool XmlPropertyListGuard::closeContainer(const Tag& tag)
{
    if (depth == 0 || tag.name != open[depth - 1].name())
        return refuse(fmt::format("the XML property list has </{}> where {} ends", tag.name,
                                  depth == 0 ? "nothing" : fmt::format("<{}>", open[depth - 1].name())));
    const Container& closed = open[--depth];
    if (closed.awaitsValue)
        return refuse("the XML property list has a <key> without a value");
    // libplist looks each new key up among the ones before it, in lists that a hostile choice of keys makes
    // long.
    return budget.takeSteps(closed.keys * (closed.keys / 2 + closed.keyBytes / 256), why);
}

bool XmlPropertyListGuard::passScalar(const Tag& tag)
{
    const bool isBoolean = tag.name == "true" || tag.name == "false";
    const bool isString = tag.name == "string";
    const bool isData = tag.name == "data";
    const bool isNumber = tag.name == "integer" || tag.name == "real" || tag.name == "date";
    if (!isBoolean && !isString && !isData && !isNumber)
        return refuse(fmt::format("the XML property list has an unknown element <{}>", tag.name));
    if (tag.empty)
        return !isNumber || refuse(fmt::format("the XML property list has an empty <{}/>", tag.name));
    std::size_t length = 0;
    if (isString)
        return passString(tag, length);

    // Plain text only: libplist puts the parts between comments together for some of these and not for
    // others.
    scalar = tag.name;
    const std::size_t end = text.find('<', position);
    if (end == std::string_view::npos)
        return endsEarly();
    const std::string_view raw = text.substr(position, end - position);
    const std::string_view content = trimmedXmlText(raw);
    position = end;
    if (!budget.takeBytes(content.size(), why) || !passEndOf(tag.name))
        return false;
    // libplist reads no number or date longer than this right.
    const bool isShort = raw.size() < (tag.name == "date" ? 32 : 400);
    const bool good = isBoolean               ? content.empty()
                      : isData                ? isXmlData(content)
                      : !isShort              ? false
                      : tag.name == "integer" ? isXmlInteger(content)
                      : tag.name == "real"    ? isXmlReal(content)
                                              : isXmlDate(content);
    return good || refuse(fmt::format("the XML property list has a malformed <{}>", tag.name));
}

/// The text of <string> or <key>, with its end tag. `length` is that of the text as it is written.
bool XmlPropertyListGuard::passString(const Tag& tag, std::size_t& length)
{
    scalar = tag.name;
    length = 0;
    if (tag.empty) {
        scalar = {};
        return true;
    }
    for (;;) {
        const std::size_t end = text.find('<', position);
        if (end == std::string_view::npos)
            return endsEarly();
        const std::string_view part = text.substr(position, end - position);
        length += part.size();
        if (!passTextPart(part))
            return false;
        position = end;
        if (at("<!--")) {
            position += 4;
            if (!passBehind("-->"))
                return false;
        } else if (constexpr auto start = "<![CDATA["sv; at(start)) {
            position += start.size();
            const std::size_t before = position;
            if (!passBehind("]]>"))
                return false;
            length += position - before;
        } else {
            return budget.takeBytes(length, why) && passEndOf(tag.name);
        }
    }
}

/// A run of text without markup; its entities must be ones that libplist reads right.
bool XmlPropertyListGuard::passTextPart(std::string_view part)
{
    for (std::size_t start = part.find('&'); start != std::string_view::npos;
         start = part.find('&', start + 1)) {
        const std::string_view name = part.substr(start + 1, 9);
        const std::size_t end = name.find(';');
        if (end == std::string_view::npos || !isXmlEntity(name.substr(0, end)))
            return refuse(fmt::format("the XML property list has an unknown entity in <{}>", scalar));
        // libplist moves all the text behind an entity when it replaces it.
        if (!budget.takeSteps((part.size() - start) / 512, why))
            return false;
    }
    return true;
}

bool XmlPropertyListGuard::passEndOf(std::string_view name)
{
    if (position + 1 == text.size())
        return endsEarly();
    if (!at("</"))
        return refuse(fmt::format("the XML property list has markup inside <{}>", name));
    Tag tag;
    if (!readTag(tag))
        return false;
    scalar = {};
    return tag.name == name ||
           refuse(fmt::format("the XML property list has </{}> where <{}> ends", tag.name, name));
}

} // namespace

std::optional<std::string_view> admitXmlPropertyList(std::string_view text, std::string& why)
{
    return XmlPropertyListGuard(text, why).rootElement();
}

} // namespace pelorus
