#pragma once

#include "model/PelorusModelNode.h"

namespace pelorus::test {

using Tree = std::shared_ptr<const PelorusModelNode>;

inline Tree leaf(std::string_view name, std::string_view value)
{
    return std::make_shared<PelorusModelLeafNode>(name, value);
}

inline Tree group(std::string_view name, PelorusModelNodes children)
{
    return std::make_shared<PelorusModelTreeNode>(name, std::move(children));
}

/// "Pelorus" and leaves "Row 1: 1" and so on below it.
inline Tree rows(int count)
{
    PelorusModelNodes children;
    for (int row = 1; row <= count; ++row)
        children.push_back(leaf("Row " + std::to_string(row), std::to_string(row)));
    return group("Pelorus", children);
}

} // namespace pelorus::test
