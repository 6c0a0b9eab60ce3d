#pragma once

#include "LogGenerator/C2K/LookupKey.h"
#include "LogGenerator/C2K/NumberText.h"
#include "LogGenerator/Osprey/Row.h"

#include <span>
#include <vector>

namespace pelorus {

/// What is published under one key: the table's text for the field's value or, where the table has none, the
/// number. Plain data that lives as long as the program.
struct PublishedRow {
    LookupKey key;
    NumberText format;
    Field field;
    TextTable texts = {};
};

/// Where the decoders publish: the rows that the display's template has for each key.
class Lookup {
public:
    /// Publishes nothing.
    Lookup() = default;
    /// `entries` is state["Lookup"]: to each key an array of {"key": title of a row, "dict": dictionary that
    /// holds the row}. The rows of a key end at the first entry that is none.
    explicit Lookup(const Dictionary& entries);

    /// Fields beyond the end of the data read as 0. A row that shows the same value already is left alone.
    void show(const PublishedRow& row, PacketView data) const;
    void show(std::span<const PublishedRow> rows, PacketView data) const;
    void publish(LookupKey key, std::string_view text) const;
    /// `format` lives as long as the program.
    void publish(LookupKey key, const NumberText& format, double value) const;
    /// The list itself, no copy, in every row.
    void publish(LookupKey key, const std::shared_ptr<Dictionary>& list) const;

    /// The list that the key's rows show; null when they show something else.
    const Dictionary* listShown(LookupKey key) const;

private:
    struct Place {
        std::shared_ptr<Dictionary> group;
        Key title;
        Value& value() const { return group->slot(title); }
    };
    static std::optional<Place> placeOf(const Value& entry);

    std::array<std::vector<Place>, kLookupKeys.size()> places;
};

} // namespace pelorus
