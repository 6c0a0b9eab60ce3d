#pragma once

#include <chrono>
#include <concepts>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <variant>
#include <vector>

namespace pelorus {

/// A dictionary key: text that is either a literal of the program, then it costs nothing to copy and
/// compares by address first, or shared text from outside.
class Key {
public:
    explicit Key(std::string text) : owner(std::make_shared<const std::string>(std::move(text))), view(*owner)
    {}
    constexpr std::string_view text() const { return view; }
    friend bool operator==(const Key& a, const Key& b) { return a == b.view; }
    friend bool operator==(const Key& a, std::string_view b)
    {
        return a.view.size() == b.size() && (a.view.data() == b.data() || a.view == b);
    }

    /// Whether it is that very literal, which an equal text from elsewhere is not. Two literals that begin at
    /// one address are one.
    constexpr bool is(std::string_view literal) const { return view.data() == literal.data(); }

private:
    struct Literal {};
    constexpr Key(Literal, std::string_view literal) : view(literal) {}
    friend struct Label;

    std::shared_ptr<const std::string> owner;
    std::string_view view;
};

/// A key that is a literal of the program: what the tables of the sections name their rows with.
struct Label {
    // NOLINTNEXTLINE(google-explicit-constructor): a literal is a label wherever one is asked for
    template <std::size_t N> consteval Label(const char (&literal)[N]) : text(literal, N - 1) {}
    std::string_view text;
    Key key() const { return Key(Key::Literal{}, text); }
};

class Array;
class Dictionary;

/// Bytes that never change once they are a value, so that copies can share them.
using Data = std::shared_ptr<const std::vector<std::byte>>;

/// A moment, as property lists hold it.
using Date = std::chrono::sys_time<std::chrono::microseconds>;

/// One property-list value. Containers are shared and mutable: copying a value that holds one gives a second
/// reference to the same container; deepCopy() gives a container of its own. The default value is nil, which
/// no container may hold.
class Value {
public:
    Value() = default;
    Value(std::string text) : held(std::move(text)) {}
    Value(std::string_view text) : held(std::string(text)) {}
    Value(const char* text) : held(std::string(text)) {}
    Value(std::int64_t number) : held(number) {}
    Value(int number) : held(std::int64_t{number}) {}
    Value(double number) : held(number) {}
    Value(bool truth) : held(truth) {}
    Value(Date date) : held(date) {}
    Value(Data data) : held(std::move(data)) {}
    Value(std::shared_ptr<Array> array) : held(std::move(array)) {}
    Value(std::shared_ptr<Dictionary> dictionary) : held(std::move(dictionary)) {}

    explicit operator bool() const { return held.index() != 0; }

    /// The value as one kind, nullptr when it is of another.
    const std::string* string() const { return std::get_if<std::string>(&held); }
    const std::int64_t* integer() const { return std::get_if<std::int64_t>(&held); }
    const double* real() const { return std::get_if<double>(&held); }
    const bool* boolean() const { return std::get_if<bool>(&held); }
    const Date* date() const { return std::get_if<Date>(&held); }
    const std::vector<std::byte>* data() const { return pointee(std::get_if<Data>(&held)); }
    Data sharedData() const
    {
        const auto* present = std::get_if<Data>(&held);
        return present ? *present : nullptr;
    }
    Array* array() const { return pointee(std::get_if<std::shared_ptr<Array>>(&held)); }
    Dictionary* dictionary() const { return pointee(std::get_if<std::shared_ptr<Dictionary>>(&held)); }
    std::shared_ptr<Array> sharedArray() const;
    std::shared_ptr<Dictionary> sharedDictionary() const;
    /// The dictionary when nobody else holds it; null otherwise.
    Dictionary* unsharedDictionary() const
    {
        const auto* present = std::get_if<std::shared_ptr<Dictionary>>(&held);
        return present && present->use_count() == 1 ? present->get() : nullptr;
    }

    /// The string to write into; a value of another kind becomes an empty string first.
    std::string& text()
    {
        origin = {};
        if (auto* present = std::get_if<std::string>(&held)) [[likely]]
            return *present;
        return held.emplace<std::string>();
    }

    /// What a text was made from: by whom (something that lives as long as the program) and of which number.
    /// Who shows the same number again need not write the text again. Whatever changes the text ends it.
    struct Origin {
        const void* maker = nullptr;
        std::int64_t number = 0;
        friend bool operator==(const Origin&, const Origin&) = default;
    };
    bool isMadeFrom(const Origin& other) const { return origin == other; }
    void setOrigin(const Origin& made) { origin = made; }

    /// Equal kind and equal content, containers compared element by element (dictionaries in any order).
    friend bool operator==(const Value& a, const Value& b);

private:
    template <class Pointer> static auto pointee(const Pointer* pointer) -> decltype(pointer->get())
    {
        return pointer ? pointer->get() : nullptr;
    }

    std::variant<std::monostate, std::string, std::int64_t, double, bool, Date, Data, std::shared_ptr<Array>,
                 std::shared_ptr<Dictionary>>
        held;
    Origin origin;
};

class Array {
public:
    std::vector<Value> elements;
};

/// Keys to values, in the order in which the keys were first set.
class Dictionary {
public:
    struct Entry {
        Key key;
        Value value;
    };

    /// nullptr when the key is absent.
    const Value* find(std::string_view key) const;
    Value* find(std::string_view key);
    /// The value under a key, nil when it is absent.
    Value at(std::string_view key) const;
    void set(const Key& key, Value value) { slot(key) = std::move(value); }
    void set(Label key, Value value) { slot(key) = std::move(value); }
    /// Text from outside; a literal is a label.
    template <class Text>
    requires(std::convertible_to<const Text&, std::string_view> &&
             !std::is_array_v<Text>) void set(const Text& key, Value value)
    {
        setText(std::string_view(key), std::move(value));
    }
    /// Where the value under a key is; a nil to be filled at once when the key was absent.
    Value& slot(const Key& key);
    Value& slot(Label key);
    /// As slot(), looking first where the key was found the last time.
    Value& slot(Label key, std::size_t& hint)
    {
        if (hint < entries.size() && entries[hint].key.is(key.text)) [[likely]]
            return entries[hint].value;
        return slotElsewhere(key, hint);
    }
    void remove(std::string_view key);
    void clear() { entries.clear(); }
    void reserve(std::size_t count) { entries.reserve(count); }
    /// For making a dictionary anew in the memory of an old one: its entries, whose values may be changed;
    /// valid until an entry is added or removed.
    Entry* first() { return entries.data(); }
    Entry* last() { return entries.data() + entries.size(); }
    /// Gives the entry at a place, which is at most size(), another key. No other entry may have that key
    /// when truncate() has ended the dictionary.
    void rewriteKey(std::size_t place, Label key);
    void truncate(std::size_t count)
    {
        entries.erase(entries.begin() + static_cast<std::ptrdiff_t>(count), entries.end());
    }
    /// Adds an entry whose key is known to be absent.
    void append(Key key, Value value) { entries.push_back({std::move(key), std::move(value)}); }
    /// Likewise; a nil to be filled at once.
    Value& append(Key key) { return entries.emplace_back(Entry{std::move(key), {}}).value; }
    std::size_t size() const { return entries.size(); }
    bool empty() const { return entries.empty(); }
    auto begin() const { return entries.begin(); }
    auto end() const { return entries.end(); }

private:
    void setText(std::string_view key, Value value);
    Value& slotElsewhere(Label key, std::size_t& hint);
    std::vector<Entry> entries;
};

inline std::shared_ptr<Array> makeArray(std::vector<Value> elements = {})
{
    auto array = std::make_shared<Array>();
    array->elements = std::move(elements);
    return array;
}

inline std::shared_ptr<Dictionary> makeDictionary()
{
    return std::make_shared<Dictionary>();
}
std::shared_ptr<Dictionary> makeDictionary(std::initializer_list<std::pair<std::string_view, Value>> entries);
Data makeData(std::vector<std::byte> bytes);

/// A value that shares no container with the original. Data, which cannot change, stays shared.
Value deepCopy(const Value& value);
/// As deepCopy(), but what equals its counterpart in `earlier`, entry by entry in the same order, is shared
/// with that: of two displays that few rows tell apart only those rows are copied. Neither may be changed
/// then.
Value deepCopySharing(const Value& value, const Value& earlier);

/// Reads a number as telephony servers send them: an integer, or a string of decimal digits with an optional
/// sign. A value outside the signed 32-bit range keeps its low 32 bits. Nothing for any other value.
std::optional<std::int32_t> signed32(const Value* value);

} // namespace pelorus
