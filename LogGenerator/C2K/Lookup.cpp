#include "LogGenerator/C2K/Lookup.h"

#include <bit>

namespace pelorus {

Lookup::Lookup(const Dictionary& entries)
{
    for (std::size_t index = 0; index < kLookupKeys.size(); ++index) {
        const Value* rows = entries.find(kLookupKeys[index]);
        if (!rows || !rows->array())
            continue;
        for (const Value& entry : rows->array()->elements) {
            auto place = placeOf(entry);
            if (!place)
                break; // rows behind it stay as they are, too: meant
            places[index].push_back(std::move(*place));
        }
    }
}

std::optional<Lookup::Place> Lookup::placeOf(const Value& entry)
{
    const Dictionary* pair = entry.dictionary();
    const Value title = pair ? pair->at("key") : Value();
    auto group = pair ? pair->at("dict").sharedDictionary() : nullptr;
    if (!title.string() || !group)
        return std::nullopt;
    for (const auto& row : *group)
        if (row.key == *title.string())
            return Place{group, row.key}; // the group's own key, which is found by its address
    return Place{std::move(group), Key(*title.string())};
}

void Lookup::show(const PublishedRow& row, PacketView data) const
{
    const std::int64_t raw = data.padded(row.field);
    const Value::Origin origin{&row, raw};
    for (const Place& place : places[row.key.index()]) {
        Value& value = place.value();
        if (value.isMadeFrom(origin))
            continue;
        if (const std::string_view text = row.texts.at(raw); !text.empty())
            value.text().assign(text);
        else
            row.format.write(value.text(), raw);
        value.setOrigin(origin);
    }
}

void Lookup::show(std::span<const PublishedRow> rows, PacketView data) const
{
    for (const PublishedRow& row : rows)
        show(row, data);
}

void Lookup::publish(LookupKey key, std::string_view text) const
{
    for (const Place& place : places[key.index()])
        place.value().text().assign(text);
}

void Lookup::publish(LookupKey key, const NumberText& format, double number) const
{
    const Value::Origin origin{&format, std::bit_cast<std::int64_t>(number)};
    for (const Place& place : places[key.index()]) {
        Value& value = place.value();
        if (value.isMadeFrom(origin))
            continue;
        format.write(value.text(), number);
        value.setOrigin(origin);
    }
}

void Lookup::publish(LookupKey key, const std::shared_ptr<Dictionary>& list) const
{
    for (const Place& place : places[key.index()])
        place.value() = list;
}

const Dictionary* Lookup::listShown(LookupKey key) const
{
    const auto& rows = places[key.index()];
    return rows.empty() ? nullptr : rows.front().value().dictionary();
}

} // namespace pelorus
