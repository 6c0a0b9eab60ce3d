#pragma once

#include "LogGenerator/Osprey/Format.h"
#include "LogGenerator/Osprey/PacketView.h"
#include "platform/Value.h"

#include <span>
#include <string_view>

namespace pelorus {

/// One value of an enumeration and what the display shows for it.
struct ValueText {
    std::int64_t value;
    std::string_view text;
};

/// Texts by value. A table of values in a run from 0 is an array of texts, where an empty one is a gap; a
/// scattered set is an array of ValueText.
class TextTable {
public:
    template <std::size_t N> constexpr TextTable(const std::string_view (&texts)[N]) : run(texts) {} // NOLINT
    template <std::size_t N> constexpr TextTable(const ValueText (&texts)[N]) : scattered(texts) {}  // NOLINT
    constexpr TextTable() = default;

    constexpr bool empty() const { return run.empty() && scattered.empty(); }
    /// Empty for a value that the table does not list.
    constexpr std::string_view at(std::int64_t value) const
    {
        if (value >= 0 && static_cast<std::size_t>(value) < run.size())
            return run[static_cast<std::size_t>(value)];
        for (const ValueText& entry : scattered)
            if (entry.value == value)
                return entry.text;
        return {};
    }

    /// Whether it lists all values that a field can have; a field of more than 8 bits is not asked.
    constexpr bool listsEvery(Field field) const
    {
        if (field.isSigned || field.bitCount > 8)
            return false;
        for (std::int64_t value = 0; value < std::int64_t{1} << field.bitCount; ++value)
            if (at(value).empty())
                return false;
        return true;
    }

private:
    std::span<const std::string_view> run;
    std::span<const ValueText> scattered;
};

/// What one row shows: plain data, made by the functions below.
struct Row {
    enum class Kind : std::uint8_t { number, fixed, text };

    Label label;
    Field field;
    Kind kind;
    Format format = "%d";
    std::int64_t scale = 1;          // of a fixed-point row in units of 1 / Format::kOne
    std::int64_t offset = 0;         // likewise
    TextTable texts = {};            // shown instead of the number, where it lists the value
    std::string_view otherwise = {}; // of a text row: for values that the table does not list; empty: no row

    /// The same row, with texts for single values ("Not Present").
    constexpr Row with(TextTable table) const
    {
        Row row = *this;
        row.texts = table;
        return row;
    }
};

/// value = field * factor + addend
struct Linear {
    int factor = 1;
    int addend = 0;
};

/// An integer row: "%d" or "%u" of the field, scaled in integers.
constexpr Row number(Label label, Format format, Field field, Linear linear = {})
{
    return {label, field, Row::Kind::number, format, linear.factor, linear.addend};
}

/// A fixed-point row: "%4.2f" or "%f" of field * factor + addend, where both have at most eight decimals. The
/// text is the one that double precision gives, without its cost.
constexpr Row level(Label label, Format format, Field field, double factor, double addend)
{
    constexpr auto kOne = static_cast<double>(Format::kOne);
    return {label,
            field,
            Row::Kind::fixed,
            format,
            static_cast<std::int64_t>(factor * kOne),
            static_cast<std::int64_t>(addend * kOne)};
}

/// A row that shows the table's text, or `otherwise` for a value that it does not list.
constexpr Row text(Label label, Field field, TextTable texts, std::string_view otherwise)
{
    return {label, field, Row::Kind::text, "%d", 1, 0, texts, otherwise};
}

/// Writes the value of `row`, which lives as long as the program; `out` keeps its memory, and its text where
/// that shows the same already. False when the row has nothing to show.
bool writeRow(const Row& row, PacketView data, Value& out);

/// Writes a number that is no field, likewise; `format` lives as long as the program.
void writeNumber(const Format& format, std::int64_t shown, Value& out);

/// Sets the rows of a keyed entry: adds or overwrites, removes nothing.
void showRows(Dictionary& entry, std::span<const Row> rows, PacketView data);

/// Makes a list's row dictionary anew in the memory of an old one: every row that is not written again goes.
class RowWriter {
public:
    explicit RowWriter(Dictionary& dictionary) : rows(dictionary), place(rows.first()), last(rows.last()) {}
    RowWriter(const RowWriter&) = delete;
    RowWriter& operator=(const RowWriter&) = delete;
    ~RowWriter() { rows.truncate(written()); }

    /// The value of the next row; rows appear in the order of these calls.
    Value& next(Label label)
    {
        if (place == last || !place->key.is(label.text)) [[unlikely]]
            placeElsewhere(label);
        return (place++)->value;
    }
    void show(std::span<const Row> table, PacketView data);

private:
    std::size_t written() const { return static_cast<std::size_t>(place - rows.first()); }
    /// Gives the place another key, or makes it.
    void placeElsewhere(Label label);

    Dictionary& rows;
    // Walking a table's rows costs little more than the comparison of two addresses a row.
    Dictionary::Entry* place;
    Dictionary::Entry* last;
};

} // namespace pelorus
