#pragma once

namespace pelorus {

// All lengths of the window are in points; a point is one of the toolkit's device-independent units.

struct Size {
    double width = 0;
    double height = 0;
    friend bool operator==(const Size&, const Size&) = default;
};

struct Rect {
    double x = 0;
    double y = 0;
    double width = 0;
    double height = 0;
    friend bool operator==(const Rect&, const Rect&) = default;
};

/// Height of the strip that a leaf's texts scroll in, and of every row.
constexpr double kStripHeight = 50;
constexpr int kCellFontSize = 15;
constexpr int kStatusFontSize = 14;

/// Where the parts of a leaf's row are. `contentSize` is what scrolls inside `scrollView`.
struct LeafLayout {
    Rect key;
    Rect value;
    Rect scrollView;
    Size contentSize;
    friend bool operator==(const LeafLayout&, const LeafLayout&) = default;
};

/// Where the name of an inner node is, in a content view with those bounds.
Rect keyFrame(const Rect& bounds, const Size& key);

/// The value is flush with the right edge when name, gap and value fit, else it follows the name and the
/// strip scrolls.
LeafLayout leafLayout(const Rect& bounds, const Size& key, const Size& value);

} // namespace pelorus
