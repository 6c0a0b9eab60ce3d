#include "platform/PropertyList.h"

#include "platform/PlistNode.h"
#include "platform/PropertyListGuard.h"
#include "platform/Utf8.h"

#include <array>
#include <bit>
#include <cmath>

namespace pelorus {

namespace {

class PropertyListWriter {
public:
    explicit PropertyListWriter(PropertyListForm form) : form(form) {}
    PlistNode nodeOf(const Value& value);

private:
    PlistNode arrayNode(const Array& array);
    PlistNode dictionaryNode(const Dictionary& dictionary);
    PlistNode dateNode(Date date) const;
    const char* cString(std::string_view text);

    PropertyListForm form;
    std::size_t depth = 0;
    std::string buffer;
};

PlistNode PropertyListWriter::nodeOf(const Value& value)
{
    if (const std::string* text = value.string())
        return PlistNode(plist_new_string(cString(*text)));
    if (const std::int64_t* number = value.integer())
        return PlistNode(
            plist_new_uint(static_cast<std::uint64_t>(*number))); // 64 bits wide it is written signed
    if (const double* number = value.real())
        return PlistNode(plist_new_real(*number));
    if (const bool* truth = value.boolean())
        return PlistNode(plist_new_bool(*truth ? 1 : 0));
    if (const Date* date = value.date())
        return dateNode(*date);
    if (const std::vector<std::byte>* bytes = value.data())
        return PlistNode(plist_new_data(bytes->empty() ? "" : reinterpret_cast<const char*>(bytes->data()),
                                        bytes->size()));
    const Array* array = value.array();
    const Dictionary* dictionary = value.dictionary();
    if ((!array && !dictionary) || depth == PropertyListLimits::depth)
        return {};
    ++depth;
    PlistNode node = array ? arrayNode(*array) : dictionaryNode(*dictionary);
    --depth;
    return node;
}

PlistNode PropertyListWriter::arrayNode(const Array& array)
{
    PlistNode node(plist_new_array());
    for (const Value& element : array.elements) {
        PlistNode child = nodeOf(element);
        if (!child)
            return {};
        plist_array_append_item(node.get(), child.release());
    }
    return node;
}

PlistNode PropertyListWriter::dictionaryNode(const Dictionary& dictionary)
{
    PlistNode node(plist_new_dict());
    for (const Dictionary::Entry& entry : dictionary) {
        PlistNode child = nodeOf(entry.value);
        if (!child)
            return {};
        plist_dict_set_item(node.get(), cString(entry.key.text()), child.release());
    }
    return node;
}

/// plist_new_date() takes 32-bit seconds, which end in 2069, so the date goes through a binary list of its
/// own.
PlistNode PropertyListWriter::dateNode(Date date) const
{
    if (date < kReferenceDate + kEarliestDate || date > kReferenceDate + kLatestDate)
        return {};
    if (form == PropertyListForm::xml)
        date = std::chrono::floor<std::chrono::seconds>(date);
    const double seconds = static_cast<double>((date - kReferenceDate).count()) / 1e6;
    std::array<char, 50> list{'b', 'p', 'l', 'i', 's', 't', '0', '0', 0x33};
    const auto bits = std::bit_cast<std::uint64_t>(seconds);
    for (std::size_t i = 0; i < 8; ++i)
        list[9 + i] = static_cast<char>(bits >> (56 - 8 * i));
    list[17] = 8;  // the offset table: the date is behind "bplist00"
    list[24] = 1;  // bytes in an offset
    list[25] = 1;  // bytes in a reference
    list[33] = 1;  // objects
    list[49] = 17; // where the offset table is
    plist_t node = nullptr;
    plist_from_bin(list.data(), list.size(), &node);
    return PlistNode(node);
}

/// With a terminator, and with U+FFFD for what no property list holds. Valid until the next call.
const char* PropertyListWriter::cString(std::string_view text)
{
    buffer.clear();
    while (!text.empty()) {
        const std::size_t valid = validUtf8Prefix(text);
        buffer += text.substr(0, valid);
        text.remove_prefix(valid);
        if (!text.empty()) {
            buffer += "\xEF\xBF\xBD";
            text.remove_prefix(1);
        }
    }
    return buffer.c_str();
}

} // namespace

std::optional<std::vector<std::byte>> serializePropertyList(const Value& value, PropertyListForm form)
{
    const PlistNode node = PropertyListWriter(form).nodeOf(value);
    if (!node)
        return std::nullopt;
    char* text = nullptr;
    std::uint32_t length = 0;
    if (form == PropertyListForm::xml) {
        const XmlNumberLocale locale;
        plist_to_xml(node.get(), &text, &length);
    } else {
        plist_to_bin(node.get(), &text, &length);
    }
    const PlistText owner(text);
    if (!text)
        return std::nullopt;
    const auto* bytes = reinterpret_cast<const std::byte*>(text);
    return std::vector<std::byte>(bytes, bytes + length);
}

} // namespace pelorus
