#include "LogGenerator/Osprey/TableSection.h"

#include <algorithm>

namespace pelorus {

namespace {

/// Whether each packet sets all that the rows ever show. A text that its table does not list leaves a row as
/// it was.
bool replaceAll(std::span<const Row> rows)
{
    return std::all_of(rows.begin(), rows.end(), [](const Row& row) {
        return row.kind != Row::Kind::text || !row.otherwise.empty() || row.texts.listsEvery(row.field);
    });
}

} // namespace

TableSection::TableSection(const SectionDescription& what) : description(what)
{
    sources.reserve(description.readings.size());
    for (const Reading& reading : description.readings)
        sources.push_back({reading, !replaceAll(reading.rows) ? nullptr
                                    : reading.show            ? reading.overtakes
                                                              : overtakesAlways});
}

std::vector<LogCode> TableSection::getLogCodeArray() const
{
    std::vector<LogCode> codes;
    for (const Reading& reading : description.readings)
        codes.push_back(reading.code);
    return codes;
}

void TableSection::updateWithData(const LogPacket& data, LogCode logCode)
{
    if (Source* source = accept(data, logCode)) {
        settle();
        show(*source, data);
    }
}

void TableSection::receive(const LogPacket& data, LogCode logCode)
{
    Source* const source = accept(data, logCode);
    if (!source)
        return;
    // The first packet makes rows that the template lacks, in the order in which the packets come. A function
    // may have something to log.
    if (!source->overtakes || !source->shown || (source->reading.show && systemLogListens())) {
        settle();
        show(*source, data);
        return;
    }
    if (!source->waiting.empty() && !source->overtakes(LogPacket(source->waiting), data))
        settle();
    if (waitingSources.empty() || waitingSources.back() != source) {
        std::erase(waitingSources, source);
        waitingSources.push_back(source);
    }
    const auto bytes = data.from(0);
    source->waiting.assign(bytes.begin(), bytes.end());
}

void TableSection::settle()
{
    for (Source* source : waitingSources) {
        show(*source, LogPacket(source->waiting));
        source->waiting.clear();
    }
    waitingSources.clear();
}

void TableSection::updateSectionRef(const Value& entry)
{
    settle();
    for (Source& source : sources)
        source.shown = false;
    Base::updateSectionRef(entry);
}

TableSection::Source* TableSection::accept(const LogPacket& data, LogCode logCode)
{
    if (systemLogListens())
        systemLog(description.bannerPriority, "%s", description.banner);
    for (Source& source : sources)
        if (source.reading.code == logCode)
            return data.covers(source.reading.minimumLength) ? &source : nullptr;
    if (description.unknownCode == UnknownCode::logged)
        logUnknownCode(logCode);
    return nullptr;
}

void TableSection::show(Source& source, const LogPacket& data)
{
    source.shown = true;
    if (!source.reading.rows.empty())
        showRows(*keyedEntry(), source.reading.rows, data);
    if (source.reading.show)
        source.reading.show(*this, data);
}

bool overtakesAlways(const LogPacket&, const LogPacket&)
{
    return true;
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
