#include "model/PelorusModelNode.h"

#include "LogGenerator/Osprey/ArrayLock.h"

#include <algorithm>
#include <fmt/format.h>

namespace pelorus {

namespace {

constexpr std::string_view kSorted = "_sorted";

using Node = std::shared_ptr<const PelorusModelNode>;

/// Builds the nodes of one tree. The path of the node in work is kept in one string that grows and shrinks.
class TreeBuilder {
public:
    explicit TreeBuilder(PathDictionary* dictionary) : paths(dictionary), path("/") {}

    Node build(std::string_view name, const Value& object)
    {
        Node node = make(name, object);
        if (paths)
            paths->insert_or_assign(path, node);
        return node;
    }

private:
    Node make(std::string_view name, const Value& object)
    {
        if (const std::string* text = object.string())
            return std::make_shared<PelorusModelLeafNode>(name, *text);
        if (const Dictionary* dictionary = object.dictionary())
            return std::make_shared<PelorusModelTreeNode>(name, childrenOf(*dictionary));
        if (const Array* array = object.array())
            return std::make_shared<PelorusModelTreeNode>(name, childrenOf(*array));
        // Numbers too: who wants one shown puts it in as a string.
        return std::make_shared<PelorusModelLeafNode>(name, "(unknown)");
    }

    Node child(std::string_view name, const Value& object)
    {
        const std::size_t parentLength = path.size();
        appendPathComponent(path, name);
        Node node = build(name, object);
        path.resize(parentLength);
        return node;
    }

    PelorusModelNodes childrenOf(const Dictionary& dictionary)
    {
        PelorusModelNodes children;
        children.reserve(dictionary.size());
        if (!isSorted(dictionary)) {
            for (const auto& [key, value] : dictionary)
                if (value)
                    children.push_back(child(key.text(), value));
            return children;
        }
        std::vector<const Dictionary::Entry*> entries;
        for (const auto& entry : dictionary)
            if (entry.value && !(entry.key == kSorted))
                entries.push_back(&entry);
        std::sort(entries.begin(), entries.end(),
                  [](const auto* a, const auto* b) { return a->key.text() < b->key.text(); });
        for (const auto* entry : entries)
            children.push_back(child(shownName(entry->key.text()), entry->value));
        return children;
    }

    /// Only that there is a mark counts, not what it says.
    static bool isSorted(const Dictionary& dictionary)
    {
        const Value* mark = dictionary.find(kSorted);
        return mark && *mark;
    }

    /// Of a sorted dictionary's key that has exactly one semicolon, what stands behind it.
    static std::string_view shownName(std::string_view key)
    {
        const std::size_t semicolon = key.find(';');
        if (semicolon == std::string_view::npos || key.find(';', semicolon + 1) != std::string_view::npos)
            return key;
        return key.substr(semicolon + 1);
    }

    PelorusModelNodes childrenOf(const Array& array)
    {
        PelorusModelNodes children;
        ArrayLock::lockArray();
        children.reserve(array.elements.size());
        for (const Value& element : array.elements) {
            const fmt::format_int name(children.size());
            children.push_back(child(std::string_view(name.data(), name.size()), element));
        }
        ArrayLock::unlockArray();
        return children;
    }

    PathDictionary* paths;
    std::string path;
};

} // namespace

void appendPathComponent(std::string& path, std::string_view name)
{
    if (path != "/")
        path += '/';
    path += name;
}

std::shared_ptr<const PelorusModelNode> PelorusModelNode::makeTreeFromObject(const Value& object,
                                                                             PathDictionary& paths)
{
    return TreeBuilder(&paths).build("Pelorus", object);
}

std::shared_ptr<const PelorusModelNode> PelorusModelNode::makeTreeFromObject(const Value& object)
{
    return TreeBuilder(nullptr).build("Pelorus", object);
}

} // namespace pelorus
