#pragma once

#include "model/PelorusModelNode.h"

#include <string>
#include <string_view>
#include <vector>

namespace pelorus {

/// The tree as a page that can be scrolled, with a status line at the bottom. It keeps its place when the
/// tree changes.
class TreeView {
public:
    explicit TreeView(bool useColours) : colours(useColours) {}

    void setTree(const PelorusModelNode& root);
    void setStatus(std::string text) { status = std::move(text); }
    /// What the terminal sent: arrows, page keys, Home, End, and their letters. False when it asks to quit.
    bool handleKeys(std::string_view keys);
    /// The screen's lines, exactly `rows` of them.
    std::vector<std::string> lines(std::size_t columns, std::size_t rows);

private:
    struct Line {
        std::size_t depth;
        std::size_t nameColumns; // the widest name among the leaves beside it
        std::string name;
        std::string value;
        bool leaf;
    };

    void add(const PelorusModelNode& node, std::size_t depth, std::size_t nameColumns);
    std::string drawn(const Line& line, std::size_t columns) const;
    std::string statusLine(std::size_t columns) const;
    void scrollBy(std::ptrdiff_t count);
    std::size_t lastTop() const;

    bool colours;
    std::vector<Line> tree;
    std::string status;
    std::size_t top = 0;
    std::size_t page = 1; // lines of the tree on the screen
};

} // namespace pelorus
