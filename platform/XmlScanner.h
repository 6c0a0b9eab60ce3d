#pragma once

#include <cstddef>
#include <optional>
#include <string_view>

namespace pelorus {

/// Walks through the little of XML that property lists use. Knows no element and words no errors: false and
/// nothing mean that the text ended too early.
class XmlScanner {
public:
    struct Tag {
        std::string_view name;
        bool closing = false; // </name>
        bool empty = false;   // <name/>
    };
    enum class Outcome { passed, ended, malformed };

    explicit XmlScanner(std::string_view text) : text(text) {}

    std::size_t position() const { return place; }
    bool ended() const { return place == text.size(); }
    bool at(std::string_view start) const { return text.substr(place).starts_with(start); }
    std::string_view since(std::size_t start) const { return text.substr(start, place - start); }

    /// Passes the text if it is there.
    bool pass(std::string_view start);
    void passSpace();
    bool passSpaceAndComments();
    bool passBehind(std::string_view end);
    /// Up to the next one of these characters, which stays. Quotes are no different from other text.
    std::optional<std::string_view> passUntil(std::string_view characters);
    /// A document type declaration; malformed when it has an internal subset ("[").
    Outcome passDocumentType();
    /// A tag without attributes. The scanner must be at "<".
    Outcome readTag(Tag& tag);

private:
    std::string_view text;
    std::size_t place = 0;
};

} // namespace pelorus
