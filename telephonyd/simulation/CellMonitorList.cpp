#include "telephonyd/simulation/CellMonitorList.h"

#include "LogGenerator/Osprey/CellMonitorKeys.h"
#include "telephonyd/simulation/PacketList.h"

namespace pelorus {

namespace {

constexpr std::uint32_t kCellMonitorList = 0xFF0001;
constexpr std::size_t kMostLayouts = 256; // more sequences than any handset meets

using NumberBytes = std::array<std::byte, 8>;

/// Big-endian, as integers stand in a binary property list.
NumberBytes toBytes(std::int64_t number)
{
    NumberBytes bytes;
    for (std::size_t i = 0; i < bytes.size(); ++i)
        bytes[i] = static_cast<std::byte>(number >> (8 * (bytes.size() - 1 - i)));
    return bytes;
}

/// A number for the place of the nth: no two are the same, and their bytes are found nowhere else in a list.
std::int64_t placeholder(std::size_t index)
{
    return static_cast<std::int64_t>(0xA5F0'E1D2'C3B4'0000U + index);
}

} // namespace

void CellMonitorList::clear()
{
    kinds.clear();
    numbers.clear();
}

void CellMonitorList::add(const MonitoredCellKind& kind, std::initializer_list<std::int64_t> values)
{
    kinds.push_back(&kind);
    numbers.insert(numbers.end(), values.begin(), values.end());
    numbers.resize(numbers.size() + kind.keys.size() - values.size());
}

CellMonitorList::Layout CellMonitorList::layOut(const Kinds& kinds)
{
    auto list = makeArray();
    std::size_t count = 0;
    for (const MonitoredCellKind* kind : kinds) {
        auto cell = makeDictionary();
        cell->set(CellMonitor::kRadioAccessTechnology, kind->technology);
        cell->set(CellMonitor::kCellType, kind->serving ? CellMonitor::kServing : CellMonitor::kNeighbor);
        for (const std::string_view key : kind->keys)
            cell->set(key, placeholder(count++));
        list->elements.emplace_back(std::move(cell));
    }
    Layout layout{packetList(list), {}};
    for (std::size_t index = 0; index < count; ++index) {
        const NumberBytes wanted = toBytes(placeholder(index));
        const auto found =
            std::search(layout.bytes.begin(), layout.bytes.end(), wanted.begin(), wanted.end());
        layout.places.push_back(static_cast<std::size_t>(found - layout.bytes.begin()));
    }
    return layout;
}

void CellMonitorList::write(MessageBatch& log)
{
    auto found = layouts.find(kinds);
    if (found == layouts.end()) {
        if (layouts.size() == kMostLayouts)
            layouts.clear();
        found = layouts.emplace(kinds, layOut(kinds)).first;
    }
    Layout& layout = found->second;
    for (std::size_t index = 0; index < numbers.size(); ++index) {
        const NumberBytes bytes = toBytes(numbers[index]);
        std::copy(bytes.begin(), bytes.end(),
                  layout.bytes.begin() + static_cast<std::ptrdiff_t>(layout.places[index]));
    }
    log.list(kCellMonitorList, layout.bytes);
}

} // namespace pelorus
