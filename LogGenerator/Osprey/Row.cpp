#include "LogGenerator/Osprey/Row.h"

namespace pelorus {

bool writeRow(const Row& row, PacketView data, Value& out)
{
    const std::int64_t raw = data[row.field];
    if (!row.texts.empty())
        if (const std::string_view text = row.texts.at(raw); !text.empty()) {
            out.text().assign(text);
            return true;
        }
    switch (row.kind) {
    case Row::Kind::number:
        row.format.write(out.text(), raw * row.scale + row.offset);
        return true;
    case Row::Kind::fixed:
        row.format.writeFixed(out.text(), raw * row.scale + row.offset);
        return true;
    case Row::Kind::text:
        out.text().assign(row.otherwise);
        return !row.otherwise.empty();
    }
    return false;
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
