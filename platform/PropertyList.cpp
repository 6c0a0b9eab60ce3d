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

/// Reads a node into `out`, which is nil. False when the node is nothing that a property list holds. The keys
/// of `like`, if given, may be the same again, as in lists of records; they are shared then.
bool read(plist_t node, Value& out, const Value* like = nullptr);

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

bool readArray(plist_t node, Value& out)
{
    out = makeArray();
    auto& elements = out.array()->elements;
    elements.reserve(plist_array_get_size(node));
    plist_array_iter iterator = nullptr;
    plist_array_new_iter(node, &iterator);
    const PlistIterator owner(iterator);
    plist_t item = nullptr;
    for (plist_array_next_item(node, iterator, &item); item; plist_array_next_item(node, iterator, &item)) {
        Value& element = elements.emplace_back();
        if (!read(item, element, elements.size() > 1 ? &element - 1 : nullptr))
            return false;
    }
    return true;
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

bool readDictionary(plist_t node, Value& out, const Dictionary* like)
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
        const std::size_t place = dictionary->size();
        sameKeys = sameKeys && place < likeEntries.size() && likeEntries[place].key == text;
        const Dictionary::Entry* const other = sameKeys ? &likeEntries[place] : nullptr;
        if (!read(item, dictionary->append(other ? other->key : Key(text)), other ? &other->value : nullptr))
            return false;
    }
    // Keys that are all those of another dictionary are known to differ.
    if (!sameKeys && mayRepeatKeys(*dictionary))
        dictionary = withoutRepeatedKeys(std::move(dictionary));
    out = std::move(dictionary);
    return true;
}

bool read(plist_t node, Value& out, const Value* like)
{
    std::uint64_t number = 0;
    switch (plist_get_node_type(node)) {
    case PLIST_STRING: {
        const char* text = plist_get_string_ptr(node, &number);
        out.text().assign(text, number);
        break;
    }
    case PLIST_UINT:
        plist_get_uint_val(node, &number);
        out = static_cast<std::int64_t>(number);
        break;
    case PLIST_UID:
        plist_get_uid_val(node, &number);
        out = static_cast<std::int64_t>(number);
        break;
    case PLIST_REAL: {
        double real = 0;
        plist_get_real_val(node, &real);
        out = real;
        break;
    }
    case PLIST_BOOLEAN: {
        std::uint8_t truth = 0;
        plist_get_bool_val(node, &truth);
        out = truth != 0;
        break;
    }
    case PLIST_DATE:
        out = dateOf(node);
        break;
    case PLIST_DATA:
        out = dataOf(node);
        break;
    case PLIST_ARRAY:
        return readArray(node, out);
    case PLIST_DICT:
        return readDictionary(node, out, like ? like->dictionary() : nullptr);
    default:
        return false;
    }
    return static_cast<bool>(out);
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
    if (root && !read(root.get(), value))
        value = {};
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
