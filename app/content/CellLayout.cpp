#include "app/content/CellLayout.h"

namespace pelorus {

namespace {

constexpr double kMargin = 10;
constexpr double kGap = 50;

} // namespace

Rect keyFrame(const Rect& bounds, const Size& key)
{
    return {bounds.x + kMargin, (bounds.height - key.height) / 2, key.width, key.height};
}

LeafLayout leafLayout(const Rect& bounds, const Size& key, const Size& value)
{
    LeafLayout layout;
    layout.key = keyFrame(bounds, key);
    // What needs the very width that is there follows the gap, and does not scroll: both comparisons are
    // meant.
    const double needed = key.width + kMargin + kGap + value.width;
    const double x =
        needed < bounds.width ? bounds.width - value.width : bounds.x + kMargin + key.width + kGap;
    layout.value = {x, (bounds.height - value.height) / 2, value.width, value.height};
    layout.contentSize = {needed > bounds.width ? bounds.width + key.width + value.width : bounds.width,
                          kStripHeight};
    layout.scrollView = {bounds.x, bounds.y, bounds.width, kStripHeight};
    return layout;
}

} // namespace pelorus
