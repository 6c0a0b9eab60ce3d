#include "LogGenerator/Osprey/TableSection.h"

#include <algorithm>

namespace pelorus {

std::vector<LogCode> TableSection::getLogCodeArray() const
{
    std::vector<LogCode> codes;
    for (const Reading& reading : description.readings)
        codes.push_back(reading.code);
    return codes;
}

void TableSection::updateWithData(const LogPacket& data, LogCode logCode)
{
    if (systemLogListens())
        systemLog(description.bannerPriority, "%s", description.banner);
    const auto reading =
        std::find_if(description.readings.begin(), description.readings.end(),
                     [logCode](const Reading& candidate) { return candidate.code == logCode; });
    if (reading == description.readings.end()) {
        if (description.unknownCode == UnknownCode::logged)
            logUnknownCode(logCode);
        return;
    }
    if (!data.covers(reading->minimumLength))
        return;
    if (!reading->rows.empty())
        showRows(*keyedEntry(), reading->rows, data);
    if (reading->show)
        reading->show(*this, data);
}

void TableSection::logUnknownCode(LogCode code)
{
    systemLog(kLogError, "Received an unknown log message: %d", static_cast<int>(code));
}

Array* TableSection::listRow(Label label)
{
    Value& row = keyedEntry()->slot(label);
    if (!row.array())
        row = makeArray();
    return row.array();
}

void TableSection::showList(Array& list, PacketView data, Records records, std::size_t count,
                            std::span<const Row> rows)
{
    const std::size_t whole = data.wholeRecords(records, count);
    rewriter.rewriteRows(list, whole, [&](std::size_t index, RowWriter& row) {
        row.show(rows, data.record(records, index, whole));
        return true;
    });
}

} // namespace pelorus
