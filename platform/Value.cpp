#include "platform/Value.h"

#include <algorithm>

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

bool equalInOrder(const Value& a, const Value& b)
{
    if (a.array() && b.array())
        return std::equal(a.array()->elements.begin(), a.array()->elements.end(), b.array()->elements.begin(),
                          b.array()->elements.end(), equalInOrder);
    if (a.dictionary() && b.dictionary())
        return std::equal(a.dictionary()->begin(), a.dictionary()->end(), b.dictionary()->begin(),
                          b.dictionary()->end(), [](const auto& left, const auto& right) {
                              return left.key == right.key && equalInOrder(left.value, right.value);
                          });
    return a == b;
}

Value copyBeside(const Value& value, const Value* earlier)
{
    if (earlier && equalInOrder(value, *earlier))
        return *earlier;
    if (const Array* array = value.array()) {
        const Array* const other = earlier ? earlier->array() : nullptr;
        auto copy = makeArray();
        copy->elements.reserve(array->elements.size());
        for (std::size_t i = 0; i < array->elements.size(); ++i)
            copy->elements.push_back(copyBeside(
                array->elements[i], other && i < other->elements.size() ? &other->elements[i] : nullptr));
        return copy;
    }
    if (const Dictionary* dictionary = value.dictionary()) {
        const Dictionary* const other = earlier ? earlier->dictionary() : nullptr;
        auto copy = makeDictionary();
        copy->reserve(dictionary->size());
        for (const auto& entry : *dictionary) {
            const Value* const before =
                other && copy->size() < other->size()
                    ? &(other->begin() + static_cast<std::ptrdiff_t>(copy->size()))->value
                    : nullptr;
            copy->append(entry.key, copyBeside(entry.value, before));
        }
        return copy;
    }
    return value;
}

} // namespace

Value deepCopy(const Value& value)
{
    return copyBeside(value, nullptr);
}

Value deepCopySharing(const Value& value, const Value& earlier)
{
    return copyBeside(value, &earlier);
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
