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
    Dictionary::Entry* place = entry.first(); // templates list the rows in the order of the tables
    Dictionary::Entry* last = entry.last();
    for (const Row& row : rows) {
        if (place == last || !place->key.is(row.label.text)) [[unlikely]] {
            auto found = static_cast<std::size_t>(place - entry.first());
            entry.slot(row.label, found);
            place = entry.first() + found;
            last = entry.last();
        }
        writeRow(row, data, place->value);
        ++place;
    }
}

void RowWriter::show(std::span<const Row> table, PacketView data)
{
    Dictionary::Entry* entry = place; // in a register, where writing a text cannot change it
    for (const Row& row : table) {
        if (entry == last || !entry->key.is(row.label.text)) [[unlikely]] {
            place = entry;
            placeElsewhere(row.label);
            entry = place;
        }
        if (writeRow(row, data, entry->value)) // else the next row takes the place
            ++entry;
    }
    place = entry;
}

void RowWriter::placeElsewhere(Label label)
{
    const std::size_t index = written();
    rows.rewriteKey(index, label);
    place = rows.first() + index;
    last = rows.last();
}

} // namespace pelorus
