#include "platform/PropertyListGuard.h"
#include "platform/XmlPropertyListText.h"
#include "platform/XmlScanner.h"

#include <fmt/format.h>

#include <array>

namespace pelorus {

namespace {

using namespace std::literals;

/// Stricter than XML: where libplist's own reading and XML differ, neither is taken but the text is refused.
class XmlPropertyListGuard {
public:
    XmlPropertyListGuard(std::string_view text, std::string& why)
        : scanner(text), why(why), budget(text.size())
    {}

    std::optional<std::string_view> rootElement();

private:
    using Tag = XmlScanner::Tag;

    struct Container {
        bool dictionary;
        bool awaitsValue; // its last element was a key
        std::uint64_t keys;
        std::uint64_t keyBytes;
        std::uint64_t pathLength;
        std::uint64_t nameLength; // of the element that comes: its key, or its place in an array

        std::string_view name() const { return dictionary ? "dict" : "array"; }
    };

    bool refuse(std::string reason)
    {
        why = std::move(reason);
        return false;
    }
    bool endsEarly();
    bool passSpaceAndComments() { return scanner.passSpaceAndComments() || endsEarly(); }
    bool passProlog();
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

    XmlScanner scanner;
    std::string& why;
    PropertyListBudget budget;
    std::size_t depth = 0;
    std::string_view scalar; // the element whose text is being read
    std::array<Container, PropertyListLimits::depth> open;
};

std::optional<std::string_view> XmlPropertyListGuard::rootElement()
{
    bool wrapped = false;
    scanner.pass("\xEF\xBB\xBF"); // the byte order mark
    if (!passProlog() || !openWrapper(wrapped) || !passSpaceAndComments())
        return std::nullopt;
    const std::size_t start = scanner.position();
    if (!passRootElement())
        return std::nullopt;
    const std::string_view root = scanner.since(start);
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

bool XmlPropertyListGuard::passProlog()
{
    while (passSpaceAndComments()) {
        const std::size_t start = scanner.position();
        if (scanner.at("<?")) {
            if (!scanner.passBehind("?>"))
                return endsEarly();
            const std::string_view instruction = scanner.since(start);
            if (instruction.starts_with("<?xml ") && !declaresUtf8(instruction))
                return refuse("the XML property list is not in UTF-8");
        } else if (scanner.at("<!DOCTYPE")) {
            const XmlScanner::Outcome outcome = scanner.passDocumentType();
            if (outcome == XmlScanner::Outcome::ended)
                return endsEarly();
            if (outcome == XmlScanner::Outcome::malformed)
                return refuse("the XML property list has document type declarations of its own");
        } else {
            return true;
        }
    }
    return false;
}

bool XmlPropertyListGuard::openWrapper(bool& wrapped)
{
    wrapped = scanner.pass("<plist");
    if (!wrapped)
        return true;
    const auto attributes = scanner.passUntil("<>");
    if (!attributes)
        return endsEarly();
    if (!attributes->empty() && (!isXmlSpace(attributes->front()) || attributes->back() == '/'))
        return refuse("the XML property list has a malformed <plist>");
    return scanner.pass(">") || refuse("the XML property list has a malformed <plist>");
}

/// Behind the list only comments may follow, and NULs, which those that send texts with their terminator add.
bool XmlPropertyListGuard::passTrailer(bool wrapped)
{
    Tag tag;
    if (wrapped) {
        if (!passSpaceAndComments())
            return false;
        if (scanner.ended())
            return refuse("the XML property list ends inside <plist>");
        if (!scanner.at("</plist"))
            return refuse("the XML property list holds more than one value");
        if (!readTag(tag))
            return false;
    }
    while (passSpaceAndComments()) {
        if (scanner.ended())
            return true;
        if (!scanner.pass("\0"sv))
            return refuse("something follows the XML property list");
    }
    return false;
}

bool XmlPropertyListGuard::readTag(Tag& tag)
{
    if (scanner.ended())
        return endsEarly();
    if (!scanner.at("<"))
        return refuse(depth > 0 ? fmt::format("the XML property list has text between the elements of <{}>",
                                              open[depth - 1].name())
                                : std::string("the bytes are no property list"));
    const std::size_t start = scanner.position();
    const XmlScanner::Outcome outcome = scanner.readTag(tag);
    if (outcome == XmlScanner::Outcome::ended)
        return endsEarly();
    // No element's name is longer than "integer".
    return (outcome == XmlScanner::Outcome::passed && tag.name.size() <= 8) ||
           refuse(fmt::format("the XML property list has a malformed tag behind {} bytes", start));
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
    if (!budget.takeValues(1, why))
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
        parent->nameLength = length;
        return true;
    }
    if (parent) {
        parent->awaitsValue = false;
        if (!budget.takePaths(1, parent->pathLength, why))
            return false;
    }
    if (tag.name != "array" && tag.name != "dict")
        return passScalar(tag);
    if (!budget.allowsDepth(depth + 1, why))
        return false;
    if (!tag.empty)
        open[depth++] = {
            tag.name == "dict", false, 0, 0, parent ? parent->pathLength + parent->nameLength + 1 : 0, 1};
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
    // libplist compares each new key with the ones before it, with all of them if they are chosen for that.
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

    // Plain text only: of some of these libplist takes just the part before a comment.
    scalar = tag.name;
    const auto raw = scanner.passUntil("<");
    if (!raw)
        return endsEarly();
    const std::string_view content = trimmedXmlText(*raw);
    if (!budget.takeBytes(content.size(), why) || !passEndOf(tag.name))
        return false;
    // libplist reads no number or date longer than this right.
    const bool isShort = raw->size() < (tag.name == "date" ? 32 : 400);
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
        const auto part = scanner.passUntil("<");
        if (!part)
            return endsEarly();
        length += part->size();
        if (!passTextPart(*part))
            return false;
        const std::size_t start = scanner.position();
        const bool isComment = scanner.pass("<!--");
        if (!isComment && !scanner.pass("<![CDATA["))
            return budget.takeBytes(length, why) && passEndOf(tag.name);
        if (!scanner.passBehind(isComment ? "-->" : "]]>"))
            return endsEarly();
        if (!isComment)
            length += scanner.since(start).size();
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
    Tag tag;
    if (!readTag(tag))
        return false;
    if (!tag.closing)
        return refuse(fmt::format("the XML property list has <{}> inside <{}>", tag.name, name));
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
