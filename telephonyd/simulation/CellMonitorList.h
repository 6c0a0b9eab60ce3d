#pragma once

#include "telephonyd/simulation/MessageBatch.h"

#include <initializer_list>
#include <map>
#include <string_view>

namespace pelorus {

/// What is told of one kind of cell in the cell monitor's list: all of them numbers, in the order of `keys`.
struct MonitoredCellKind {
    std::string_view technology; // a value of CellMonitor, as are the keys
    bool serving = false;
    std::span<const std::string_view> keys;
};

/// Makes the cell monitor's lists, code 0xFF0001. A property list is dear to make, and this one changes with
/// every level. So it is laid out once for each sequence of kinds, with every number in 8 bytes, and the
/// numbers are then put where they stand.
class CellMonitorList {
public:
    /// Begins a list.
    void clear();
    /// The next cell. `kind` outlives the list; a measurement that is missing is CellMonitor::kUnavailable.
    void add(const MonitoredCellKind& kind, std::initializer_list<std::int64_t> values);
    void write(MessageBatch& log);

private:
    struct Layout {
        std::vector<std::byte> bytes;
        std::vector<std::size_t> places; // of the numbers
    };
    using Kinds = std::vector<const MonitoredCellKind*>;

    static Layout layOut(const Kinds& kinds);

    Kinds kinds;
    std::vector<std::int64_t> numbers;
    std::map<Kinds, Layout> layouts;
};

} // namespace pelorus
