#pragma once

#include <string>

namespace pelorus {

/// What a pane puts into the bottom toolbar, left to right: an activity indicator that hides when it does not
/// run, the status, a flexible space, and the Save button.
struct ToolbarItems {
    bool indicatorRuns = false;
    std::string status;
    bool offersSave = false;
    friend bool operator==(const ToolbarItems&, const ToolbarItems&) = default;
};

} // namespace pelorus
