#pragma once

#include "model/PelorusModelNode.h"

#include <optional>

namespace pelorus {

/// The rows of a pane: the children of its node. A row is known by its identity, which it keeps when rows
/// come and go around it: its name, and how many rows of the same name precede it.
class PaneRows {
public:
    explicit PaneRows(std::shared_ptr<const PelorusModelNode> node = nullptr);

    int count() const { return static_cast<int>(identities.size()); }
    const std::shared_ptr<const PelorusModelNode>& at(int row) const
    {
        return (*node->childNodes())[static_cast<std::size_t>(row)];
    }
    const std::string& identityOf(int row) const { return identities[static_cast<std::size_t>(row)]; }
    std::optional<int> find(const std::string& identity) const;

    /// The row as text, with all that is below it, two blanks a level: "Name: value", one line a node.
    std::string textOf(int row) const;
    /// All rows as text.
    std::string text() const;

private:
    std::shared_ptr<const PelorusModelNode> node;
    std::vector<std::string> identities;
    std::unordered_map<std::string, int> places;
};

} // namespace pelorus
