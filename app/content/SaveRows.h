#pragma once

#include "platform/Value.h"

namespace pelorus {

/// The texts of the save screen's rows: of each entry what stands under "Description", empty when nothing
/// does.
std::vector<std::string> saveRowTexts(const std::shared_ptr<Array>& saveHistory);

} // namespace pelorus
