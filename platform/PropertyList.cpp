#include "platform/PropertyList.h"

#include "platform/PlistNode.h"
#include "platform/PropertyListGuard.h"

#include <fmt/format.h>

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstring>
#include <limits>

namespace pelorus {

namespace {

/// `like` is a dictionary whose keys may be the same again, as in lists of records; they are shared then.
Value valueOf(plist_t node, const Dictionary* like = nullptr);

/// libplist hands a date out in 32-bit seconds and cuts the microseconds off. What those two cannot tell
/// comes from the date's binary form.
Value dateOf(plist_t node)
{
    std::int32_t seconds = 0;
    std::int32_t microseconds = 0;
    plist_get_date_val(node, &seconds, &microseconds);
    if (microseconds == 0 && seconds > std::numeric_limits<std::int32_t>::min() &&
        seconds < std::numeric_limits<std::int32_t>::max())
        return kReferenceDate + std::chrono::seconds{seconds};

    constexpr std::size_t position = 9; // behind "bplist00" and the date's marker
    char* bytes = nullptr;
    std::uint32_t length = 0;
    plist_to_bin(node, &bytes, &length);
    const PlistText owner(bytes);
    if (length < position + 8)
        return {};
    std::uint64_t bits = 0;
    for (std::size_t i = 0; i < 8; ++i)
        bits = bits << 8 | static_cast<unsigned char>(bytes[position + i]);
    return kReferenceDate + std::chrono::microseconds{std::llround(std::bit_cast<double>(bits) * 1e6)};
}

Value dataOf(plist_t node)
{
    std::uint64_t length = 0;
    const auto* bytes = reinterpret_cast<const std::byte*>(plist_get_data_ptr(node, &length));
    return makeData(bytes ? std::vector<std::byte>(bytes, bytes + length) : std::vector<std::byte>());
}

Value arrayOf(plist_t node)
{
    auto array = makeArray();
    array->elements.reserve(plist_array_get_size(node));
    plist_array_iter iterator = nullptr;
    plist_array_new_iter(node, &iterator);
    const PlistIterator owner(iterator);
    const Dictionary* previous = nullptr;
    plist_t item = nullptr;
    for (plist_array_next_item(node, iterator, &item); item; plist_array_next_item(node, iterator, &item)) {
        Value element = valueOf(item, previous);
        if (!element)
            return {};
        if (const Dictionary* dictionary = element.dictionary())
            previous = dictionary;
        array->elements.push_back(std::move(element));
    }
    return array;
}

/// The entries' positions, sorted by key and equal keys by position.
std::vector<std::size_t> sortedByKey(const Dictionary& dictionary)
{
    std::vector<std::size_t> order(dictionary.size());
    for (std::size_t i = 0; i < order.size(); ++i)
        order[i] = i;
    const std::span entries(dictionary.begin(), dictionary.end());
    std::sort(order.begin(), order.end(), [entries](std::size_t a, std::size_t b) {
        const int difference = entries[a].key.text().compare(entries[b].key.text());
        return difference != 0 ? difference < 0 : a < b;
    });
    return order;
}

/// Binary lists come out of libplist with repeated keys. Those keep the first one's place and the last one's
/// value; nothing here takes quadratic time, whatever the number of keys.
std::shared_ptr<Dictionary> withoutRepeatedKeys(std::shared_ptr<Dictionary> dictionary)
{
    const std::vector<std::size_t> order = sortedByKey(*dictionary);
    const std::span entries(dictionary->begin(), dictionary->end());
    constexpr std::size_t none = std::numeric_limits<std::size_t>::max();
    std::vector<std::size_t> valueFrom(order.size(), none);
    std::size_t count = 0;
    for (std::size_t i = 0; i < order.size(); ++count) {
        const std::size_t first = order[i];
        std::size_t last = first;
        for (; i < order.size() && entries[order[i]].key == entries[first].key; ++i)
            last = order[i];
        valueFrom[first] = last;
    }
    if (count == order.size())
        return dictionary;
    auto unique = makeDictionary();
    unique->reserve(count);
    for (std::size_t i = 0; i < valueFrom.size(); ++i)
        if (valueFrom[i] != none)
            unique->append(entries[i].key, entries[valueFrom[i]].value);
    return unique;
}

bool mayRepeatKeys(const Dictionary& dictionary)
{
    if (dictionary.size() > 32)
        return true;
    for (auto entry = dictionary.begin(); entry != dictionary.end(); ++entry)
        for (auto other = dictionary.begin(); other != entry; ++other)
            if (entry->key == other->key)
                return true;
    return false;
}

Value dictionaryOf(plist_t node, const Dictionary* like)
{
    auto dictionary = makeDictionary();
    dictionary->reserve(plist_dict_get_size(node));
    plist_dict_iter iterator = nullptr;
    plist_dict_new_iter(node, &iterator);
    const PlistIterator owner(iterator);
    const auto likeEntries =
        like ? std::span(like->begin(), like->end()) : std::span<const Dictionary::Entry>();
    bool sameKeys = like != nullptr;
    char* text = nullptr;
    plist_t item = nullptr;
    for (plist_dict_next_item(node, iterator, &text, &item); text && item;
         plist_dict_next_item(node, iterator, &text, &item)) {
        const PlistText keyOwner(text);
        Value value = valueOf(item);
        if (!value)
            return {};
        const std::size_t place = dictionary->size();
        sameKeys = sameKeys && place < likeEntries.size() && likeEntries[place].key == text;
        dictionary->append(sameKeys ? likeEntries[place].key : Key(text), std::move(value));
    }
    // Keys that are all those of another dictionary are known to differ.
    if (!sameKeys && mayRepeatKeys(*dictionary))
        return withoutRepeatedKeys(std::move(dictionary));
    return dictionary;
}

Value valueOf(plist_t node, const Dictionary* like)
{
    std::uint64_t number = 0;
    switch (plist_get_node_type(node)) {
    case PLIST_STRING: {
        const char* text = plist_get_string_ptr(node, &number);
        return std::string(text, number);
    }
    case PLIST_UINT:
        plist_get_uint_val(node, &number);
        return static_cast<std::int64_t>(number);
    case PLIST_UID:
        plist_get_uid_val(node, &number);
        return static_cast<std::int64_t>(number);
    case PLIST_REAL: {
        double real = 0;
        plist_get_real_val(node, &real);
        return real;
    }
    case PLIST_BOOLEAN: {
        std::uint8_t truth = 0;
        plist_get_bool_val(node, &truth);
        return truth != 0;
    }
    case PLIST_DATE:
        return dateOf(node);
    case PLIST_DATA:
        return dataOf(node);
    case PLIST_ARRAY:
        return arrayOf(node);
    case PLIST_DICT:
        return dictionaryOf(node, like);
    default:
        return {};
    }
}

PlistNode readBinary(std::span<const std::byte> bytes, std::string& why)
{
    plist_t node = nullptr;
    if (admitsBinaryPropertyList(bytes, why))
        plist_from_bin(reinterpret_cast<const char*>(bytes.data()), static_cast<std::uint32_t>(bytes.size()),
                       &node);
    return PlistNode(node);
}

PlistNode readXml(std::span<const std::byte> bytes, std::string& why)
{
    plist_t node = nullptr;
    const std::string_view text(reinterpret_cast<const char*>(bytes.data()), bytes.size());
    if (const auto root = admitXmlPropertyList(text, why)) {
        const XmlNumberLocale locale;
        plist_from_xml(root->data(), static_cast<std::uint32_t>(root->size()), &node);
    }
    return PlistNode(node);
}

Value parse(std::span<const std::byte> bytes, std::string& why)
{
    if (bytes.empty()) {
        why = "the property list is empty";
        return {};
    }
    if (bytes.size() > PropertyListLimits::input) {
        why = fmt::format("the property list is {} bytes, more than {}", bytes.size(),
                          PropertyListLimits::input);
        return {};
    }
    constexpr std::string_view magic = "bplist00";
    const bool isBinary =
        bytes.size() >= magic.size() && std::memcmp(bytes.data(), magic.data(), magic.size()) == 0;
    const PlistNode root = isBinary ? readBinary(bytes, why) : readXml(bytes, why);
    Value value;
    if (root)
        value = valueOf(root.get());
    if (!value && why.empty())
        why = fmt::format("libplist cannot read the {} property list", isBinary ? "binary" : "XML");
    return value;
}

} // namespace

Value parsePropertyList(std::span<const std::byte> bytes, std::string* why)
{
    std::string reason;
    Value value = parse(bytes, reason);
    if (why && !value)
        *why = std::move(reason);
    return value;
}

} // namespace pelorus
