#pragma once

namespace pelorus {

/// Points of the bars above and below the pane.
constexpr int kBarHeight = 48;

} // namespace pelorus
