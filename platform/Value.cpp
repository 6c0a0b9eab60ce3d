#include "platform/Value.h"

#include <algorithm>
#include <span>

namespace pelorus {

std::shared_ptr<Array> Value::sharedArray() const
{
    const auto* present = std::get_if<std::shared_ptr<Array>>(&held);
    return present ? *present : nullptr;
}

std::shared_ptr<Dictionary> Value::sharedDictionary() const
{
    const auto* present = std::get_if<std::shared_ptr<Dictionary>>(&held);
    return present ? *present : nullptr;
}

bool operator==(const Value& a, const Value& b)
{
    if (a.held.index() != b.held.index())
        return false;
    if (a.array())
        return a.array()->elements == b.array()->elements;
    if (const Dictionary* left = a.dictionary()) {
        const Dictionary* right = b.dictionary();
        return left->size() == right->size() &&
               std::all_of(left->begin(), left->end(), [right](const Dictionary::Entry& entry) {
                   const Value* other = right->find(entry.key.text());
                   return other && *other == entry.value;
               });
    }
    if (a.data())
        return *a.data() == *b.data();
    return a.held == b.held;
}

const Value* Dictionary::find(std::string_view key) const
{
    const auto found =
        std::find_if(entries.begin(), entries.end(), [key](const Entry& entry) { return entry.key == key; });
    return found == entries.end() ? nullptr : &found->value;
}

Value* Dictionary::find(std::string_view key)
{
    return const_cast<Value*>(static_cast<const Dictionary*>(this)->find(key));
}

Value Dictionary::at(std::string_view key) const
{
    const Value* found = find(key);
    return found ? *found : Value();
}

void Dictionary::setText(std::string_view key, Value value)
{
    if (Value* present = find(key))
        *present = std::move(value);
    else
        append(Key(std::string(key)), std::move(value));
}

Value& Dictionary::slot(const Key& key)
{
    if (Value* present = find(key.text()))
        return *present;
    return entries.emplace_back(Entry{key, {}}).value;
}

Value& Dictionary::slot(Label key)
{
    std::size_t hint = 0;
    return slot(key, hint);
}

Value& Dictionary::slotElsewhere(Label key, std::size_t& hint)
{
    const auto holds = [key](const Entry& entry) { return entry.key == key.text; };
    const bool guessed = hint < entries.size() && holds(entries[hint]);
    const auto found = guessed ? entries.begin() + static_cast<std::ptrdiff_t>(hint)
                               : std::find_if(entries.begin(), entries.end(), holds);
    hint = static_cast<std::size_t>(found - entries.begin());
    if (found == entries.end())
        entries.push_back({key.key(), {}});
    else
        found->key = key.key(); // found by its address the next time
    return entries[hint].value;
}

void Dictionary::rewriteKey(std::size_t place, Label key)
{
    if (place == entries.size())
        entries.push_back({key.key(), {}});
    else
        entries[place].key = key.key();
}

void Dictionary::remove(std::string_view key)
{
    std::erase_if(entries, [key](const Entry& entry) { return entry.key == key; });
}

std::shared_ptr<Dictionary> makeDictionary(std::initializer_list<std::pair<std::string_view, Value>> entries)
{
    auto dictionary = makeDictionary();
    for (const auto& [key, value] : entries)
        dictionary->set(key, value);
    return dictionary;
}

Data makeData(std::vector<std::byte> bytes)
{
    return std::make_shared<const std::vector<std::byte>>(std::move(bytes));
}

namespace {

/// Nothing when the value equals `earlier`, else a copy that shares with it what does. Each value is looked
/// at once: to ask for equality on every level takes the depth times as long.
std::optional<Value> changedCopy(const Value& value, const Value& earlier);

std::optional<Value> changedArray(const Array& array, const Array& earlier)
{
    const auto& before = earlier.elements;
    std::shared_ptr<Array> copy; // none while all elements are equal
    const auto startCopy = [&](std::size_t place) {
        copy = makeArray();
        copy->elements.reserve(array.elements.size());
        copy->elements.assign(before.begin(), before.begin() + static_cast<std::ptrdiff_t>(place));
    };
    if (array.elements.size() < before.size())
        startCopy(0);
    for (std::size_t i = 0; i < array.elements.size(); ++i) {
        std::optional<Value> changed = i < before.size() ? changedCopy(array.elements[i], before[i])
                                                         : std::optional(deepCopy(array.elements[i]));
        if (changed && !copy)
            startCopy(i);
        if (copy)
            copy->elements.push_back(changed ? *std::move(changed) : before[i]);
    }
    return copy ? std::optional<Value>(std::move(copy)) : std::nullopt;
}

std::optional<Value> changedDictionary(const Dictionary& dictionary, const Dictionary& earlier)
{
    const auto before = std::span(earlier.begin(), earlier.end());
    std::shared_ptr<Dictionary> copy;
    const auto startCopy = [&](std::size_t place) {
        copy = makeDictionary();
        copy->reserve(dictionary.size());
        for (const auto& entry : before.first(place))
            copy->append(entry.key, entry.value);
    };
    if (dictionary.size() < before.size())
        startCopy(0);
    std::size_t i = 0;
    for (const auto& [key, value] : dictionary) {
        std::optional<Value> changed =
            i < before.size() ? changedCopy(value, before[i].value) : std::optional(deepCopy(value));
        if (!copy && (changed || !(key == before[i].key)))
            startCopy(i);
        if (copy)
            copy->append(key, changed ? *std::move(changed) : before[i].value);
        ++i;
    }
    return copy ? std::optional<Value>(std::move(copy)) : std::nullopt;
}

std::optional<Value> changedCopy(const Value& value, const Value& earlier)
{
    if (value.array() && earlier.array())
        return changedArray(*value.array(), *earlier.array());
    if (value.dictionary() && earlier.dictionary())
        return changedDictionary(*value.dictionary(), *earlier.dictionary());
    if (value.data()) // shared as it is, and long to compare
        return value;
    return value == earlier ? std::nullopt : std::optional(deepCopy(value));
}

} // namespace

Value deepCopy(const Value& value)
{
    if (const Array* array = value.array()) {
        auto copy = makeArray();
        copy->elements.reserve(array->elements.size());
        for (const Value& element : array->elements)
            copy->elements.push_back(deepCopy(element));
        return copy;
    }
    if (const Dictionary* dictionary = value.dictionary()) {
        auto copy = makeDictionary();
        copy->reserve(dictionary->size());
        for (const auto& entry : *dictionary)
            copy->append(entry.key, deepCopy(entry.value));
        return copy;
    }
    return value;
}

Value deepCopySharing(const Value& value, const Value& earlier)
{
    return changedCopy(value, earlier).value_or(earlier);
}

std::optional<std::int32_t> signed32(const Value* value)
{
    if (!value)
        return std::nullopt;
    if (const std::int64_t* number = value->integer())
        return static_cast<std::int32_t>(static_cast<std::uint32_t>(*number));
    const std::string* text = value->string();
    if (!text)
        return std::nullopt;
    std::string_view digits = *text;
    const bool negative = digits.starts_with('-');
    if (negative || digits.starts_with('+'))
        digits.remove_prefix(1);
    if (digits.empty())
        return std::nullopt;
    std::uint32_t low = 0; // wraps: only the low 32 bits count
    for (const char digit : digits) {
        if (digit < '0' || digit > '9')
            return std::nullopt;
        low = low * 10 + static_cast<std::uint32_t>(digit - '0');
    }
    return static_cast<std::int32_t>(negative ? 0U - low : low);
}

} // namespace pelorus
