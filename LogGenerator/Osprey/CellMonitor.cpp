#include "LogGenerator/Osprey/CellMonitor.h"

#include "platform/SystemLog.h"

#include <algorithm>

namespace pelorus {

namespace {

bool holds(const Dictionary& cell, std::string_view key, std::string_view text)
{
    const Value* value = cell.find(key);
    return value && value->string() && *value->string() == text;
}

template <class SlotOf>
void showNumbers(std::span<const CellRow> rows, const Dictionary& cell, const SlotOf& slotOf)
{
    for (const CellRow& row : rows) {
        const std::optional<std::int32_t> number = signed32(cell.find(row.key));
        if (!number) {
            if (!row.missing.empty())
                systemLog(kLogError, "%s", row.missing);
        } else if (row.blankWhenUnavailable && *number == CellMonitor::kUnavailable) {
            slotOf(row.label).text().clear();
        } else {
            row.format.write(slotOf(row.label).text(), std::int64_t{*number} * row.factor);
        }
    }
}

} // namespace

const Array* cellMonitorList(const LogPacket& data)
{
    const Value& list = data.propertyList();
    if (!list)
        systemLog(kLogError, "Cell Info Array data could not be constructed");
    return list.array();
}

const Array* requiredCellMonitorList(const LogPacket& data)
{
    const Array* list = cellMonitorList(data);
    if (!list)
        systemLog(kLogError, "Failed to get Cell Array\n");
    return list;
}

bool isCell(const Value& cell, std::initializer_list<std::string_view> technologies, std::string_view type)
{
    const Dictionary* entries = cell.dictionary();
    return entries && holds(*entries, CellMonitor::kCellType, type) &&
           std::any_of(technologies.begin(), technologies.end(), [entries](std::string_view technology) {
               return holds(*entries, CellMonitor::kRadioAccessTechnology, technology);
           });
}

const Dictionary* firstCell(const Array& cells, std::initializer_list<std::string_view> technologies,
                            std::string_view type)
{
    const auto found = std::find_if(cells.elements.begin(), cells.elements.end(),
                                    [&](const Value& cell) { return isCell(cell, technologies, type); });
    return found == cells.elements.end() ? nullptr : found->dictionary();
}

void showCellRows(Dictionary& entry, std::span<const CellRow> rows, const Dictionary& cell)
{
    showNumbers(rows, cell, [&entry](Label label) -> Value& { return entry.slot(label); });
}

void showCellRows(RowWriter& entry, std::span<const CellRow> rows, const Dictionary& cell)
{
    showNumbers(rows, cell, [&entry](Label label) -> Value& { return entry.next(label); });
}

} // namespace pelorus
