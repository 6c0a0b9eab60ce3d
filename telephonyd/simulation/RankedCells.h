#pragma once

#include <algorithm>
#include <array>
#include <cstddef>

namespace pelorus {

/// Cells by their index in a network's table, the one with the highest rank first.
template <std::size_t Capacity> class RankedCells {
public:
    /// At most `Capacity` of them.
    void add(std::size_t cell, double rank)
    {
        std::size_t place = count++;
        for (; place > 0 && ranks[place - 1] < rank; --place) {
            cells[place] = cells[place - 1];
            ranks[place] = ranks[place - 1];
        }
        cells[place] = cell;
        ranks[place] = rank;
    }
    void limit(std::size_t most) { count = std::min(count, most); }

    std::size_t size() const { return count; }
    bool empty() const { return count == 0; }
    std::size_t front() const { return cells[0]; }
    const std::size_t* begin() const { return cells.data(); }
    const std::size_t* end() const { return cells.data() + count; }

private:
    std::array<std::size_t, Capacity> cells{};
    std::array<double, Capacity> ranks{};
    std::size_t count = 0;
};

} // namespace pelorus
