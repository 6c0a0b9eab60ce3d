#include "platform/PropertyList.h"

#include "platform/BinaryPropertyListReader.h"
#include "platform/PlistNode.h"
#include "platform/PropertyListGuard.h"

#include <fmt/format.h>

#include <bit>
#include <cmath>
#include <cstring>
#include <limits>

namespace pelorus {

namespace {

/// Reads a node into `out`, which is nil. False when the node is nothing that a property list holds. The keys
/// of `like`, if given, may be the same again, as in lists of records; they are shared then.
bool read(plist_t node, Value& out, const Value* like = nullptr);

/// libplist hands a date out in 32-bit seconds and cuts the microseconds off, so it comes from its binary
/// form.
Value dateOf(plist_t node)
{
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

Value readXml(std::span<const std::byte> bytes, std::string& why)
{
    const std::string_view text(reinterpret_cast<const char*>(bytes.data()), bytes.size());
    const auto element = admitXmlPropertyList(text, why);
    if (!element)
        return {};
    plist_t node = nullptr;
    const XmlNumberLocale locale;
    plist_from_xml(element->data(), static_cast<std::uint32_t>(element->size()), &node);
    const PlistNode root(node);
    Value value;
    if (!root || !read(root.get(), value)) {
        why = "libplist cannot read the XML property list";
        return {};
    }
    return value;
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
    return isBinary ? readBinaryPropertyList(bytes, why) : readXml(bytes, why);
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
