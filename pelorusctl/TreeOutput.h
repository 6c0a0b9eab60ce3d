#pragma once

#include "model/PelorusModelNode.h"

#include <chrono>
#include <optional>
#include <string>

namespace pelorus {

/// The tree as text: a line a node, two blanks of indentation a level, "name: value" a leaf.
std::string treeText(const PelorusModelNode& root);

/// The tree and the time of the last message (null when there was none) as one line of JSON. Bytes that are
/// no UTF-8 are shown as U+FFFD.
std::string treeJson(const PelorusModelNode& root,
                     std::optional<std::chrono::sys_time<std::chrono::nanoseconds>> lastMessage);

} // namespace pelorus
