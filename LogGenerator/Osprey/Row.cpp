#include "LogGenerator/Osprey/Row.h"

namespace pelorus {

bool writeRow(const Row& row, PacketView data, Value& out)
{
    const std::int64_t raw = data[row.field];
    const Value::Origin origin{&row, raw};
    if (out.isMadeFrom(origin))
        return true;
    std::string& shown = out.text();
    const std::string_view text = row.texts.empty() ? std::string_view() : row.texts.at(raw);
    if (!text.empty())
        shown.assign(text);
    else if (row.kind == Row::Kind::number)
        row.format.write(shown, raw * row.scale + row.offset);
    else if (row.kind == Row::Kind::fixed)
        row.format.writeFixed(shown, raw * row.scale + row.offset);
    else if (row.otherwise.empty())
        return false;
    else
        shown.assign(row.otherwise);
    out.setOrigin(origin);
    return true;
}

void writeNumber(const Format& format, std::int64_t shown, Value& out)
{
    const Value::Origin origin{&format, shown};
    if (out.isMadeFrom(origin))
        return;
    format.write(out.text(), shown);
    out.setOrigin(origin);
}

void showRows(Dictionary& entry, std::span<const Row> rows, PacketView data)
{
    std::size_t place = 0; // templates list the rows in the order of the tables
    for (const Row& row : rows) {
        writeRow(row, data, entry.slot(row.label, place));
        ++place;
    }
}

void RowWriter::show(std::span<const Row> table, PacketView data)
{
    for (const Row& row : table)
        if (!writeRow(row, data, rows.rewrite(written, row.label)))
            continue; // the place is used by the next row
        else
            ++written;
}

} // namespace pelorus
