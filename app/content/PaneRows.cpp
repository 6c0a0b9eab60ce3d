#include "app/content/PaneRows.h"

#include <fmt/format.h>

namespace pelorus {

namespace {

void appendText(std::string& text, const PelorusModelNode& node, std::size_t indent)
{
    text.append(indent, ' ').append(node.displayName());
    if (const std::string* value = node.value())
        text.append(": ").append(*value);
    text += '\n';
    if (const PelorusModelNodes* children = node.childNodes())
        for (const auto& child : *children)
            appendText(text, *child, indent + 2);
}

} // namespace

PaneRows::PaneRows(std::shared_ptr<const PelorusModelNode> shown) : node(std::move(shown))
{
    const PelorusModelNodes* children = node ? node->childNodes() : nullptr;
    if (!children)
        return;
    identities.reserve(children->size());
    places.reserve(children->size());
    std::unordered_map<std::string_view, int> repeated;
    for (const auto& child : *children) {
        std::string identity = child->displayName();
        if (places.contains(identity))
            identity =
                fmt::format("{}{}{}", identity, '\0', ++repeated[child->displayName()]); // as no name is
        places.emplace(identity, count());
        identities.push_back(std::move(identity));
    }
}

std::optional<int> PaneRows::find(const std::string& identity) const
{
    const auto place = places.find(identity);
    return place == places.end() ? std::nullopt : std::optional(place->second);
}

std::string PaneRows::textOf(int row) const
{
    std::string text;
    appendText(text, *at(row), 0);
    text.pop_back();
    return text;
}

std::string PaneRows::text() const
{
    std::string text;
    for (int row = 0; row < count(); ++row)
        appendText(text, *at(row), 0);
    return text;
}

} // namespace pelorus
