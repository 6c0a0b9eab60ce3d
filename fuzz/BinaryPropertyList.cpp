// Binary property lists from anybody, read by our reader and by libplist: of a list that both take they make
// the same.
//
// libplist trusts a list with its depth and its size, so it sees only those that our reader takes.

#include "fuzz/Input.h"
#include "fuzz/PropertyListEquality.h"
#include "fuzz/Require.h"
#include "platform/BinaryPropertyListReader.h"

#include <bit>
#include <cmath>
#include <memory>
#include <plist/plist.h>

using namespace pelorus;
using namespace pelorus::fuzz;

namespace {

using Node = std::unique_ptr<void, decltype(&plist_free)>;

constexpr std::string_view kReplacement = "\xEF\xBF\xBD";

/// Of half a surrogate pair libplist makes nothing, our reader U+FFFD: there they may differ.
bool isSameText(std::string_view ours, std::string_view theirs)
{
    return ours == theirs || ours.find(kReplacement) != std::string_view::npos;
}

bool isSameDate(Date ours, plist_t node)
{
    std::int32_t seconds = 0;
    std::int32_t microseconds = 0; // cut off, not rounded
    plist_get_date_val(node, &seconds, &microseconds);
    constexpr Date kReference = std::chrono::sys_days(std::chrono::January / 1 / 2001);
    const auto since = std::chrono::abs(ours - kReference);
    if (since > std::chrono::seconds(std::int64_t{1} << 30)) // libplist's seconds have 32 bits
        return true;
    const auto theirs = kReference + std::chrono::seconds(seconds) +
                        std::chrono::microseconds(ours < kReference ? -microseconds : microseconds);
    return std::chrono::abs(ours - theirs) <= std::chrono::microseconds(1);
}

bool isSameNode(const Value& ours, plist_t node);

bool isSameArray(const Array& ours, plist_t node)
{
    if (plist_array_get_size(node) != ours.elements.size())
        return false;
    plist_array_iter place = nullptr;
    plist_array_new_iter(node, &place);
    const std::unique_ptr<void, decltype(&std::free)> owner(place, &std::free);
    for (const Value& element : ours.elements) {
        plist_t item = nullptr;
        plist_array_next_item(node, place, &item);
        if (!item || !isSameNode(element, item))
            return false;
    }
    return true;
}

/// Of a key that is repeated libplist keeps every value, our reader the first one's place and the last one's
/// value.
bool isSameDictionary(const Dictionary& ours, plist_t node)
{
    Dictionary seen;
    plist_dict_iter place = nullptr;
    plist_dict_new_iter(node, &place);
    const std::unique_ptr<void, decltype(&std::free)> owner(place, &std::free);
    std::vector<plist_t> items;
    for (std::uint32_t left = plist_dict_get_size(node); left > 0; --left) {
        char* text = nullptr;
        plist_t item = nullptr;
        plist_dict_next_item(node, place, &text, &item);
        if (!text || !item)
            return false;
        const std::string key(text);
        std::free(text);
        if (const Value* earlier = seen.find(key)) {
            items[static_cast<std::size_t>(*earlier->integer())] = item;
        } else {
            seen.set(key, static_cast<std::int64_t>(items.size()));
            items.push_back(item);
        }
    }
    if (seen.size() != ours.size())
        return ours.size() > 0 && std::any_of(ours.begin(), ours.end(), [](const auto& entry) {
                   return entry.key.text().find(kReplacement) != std::string_view::npos; // one key for them
               });
    std::size_t index = 0;
    for (const auto& [key, value] : ours) {
        if (!isSameText(key.text(), (seen.begin() + static_cast<std::ptrdiff_t>(index))->key.text()) ||
            !isSameNode(value, items[index]))
            return false;
        ++index;
    }
    return true;
}

bool isSameNode(const Value& ours, plist_t node)
{
    std::uint64_t number = 0;
    switch (plist_get_node_type(node)) {
    case PLIST_STRING: {
        const char* text = plist_get_string_ptr(node, &number);
        return ours.string() && isSameText(*ours.string(), {text, number});
    }
    case PLIST_UINT:
        plist_get_uint_val(node, &number);
        return ours.integer() && static_cast<std::uint64_t>(*ours.integer()) == number;
    case PLIST_UID:
        plist_get_uid_val(node, &number);
        return ours.integer() && static_cast<std::uint64_t>(*ours.integer()) == number;
    case PLIST_REAL: {
        double real = 0;
        plist_get_real_val(node, &real);
        return ours.real() && isSame(ours, Value(real));
    }
    case PLIST_BOOLEAN: {
        std::uint8_t truth = 0;
        plist_get_bool_val(node, &truth);
        return ours.boolean() && *ours.boolean() == (truth != 0);
    }
    case PLIST_DATE:
        return ours.date() && isSameDate(*ours.date(), node);
    case PLIST_DATA: {
        const auto* bytes = reinterpret_cast<const std::byte*>(plist_get_data_ptr(node, &number));
        return ours.data() && std::equal(ours.data()->begin(), ours.data()->end(), bytes, bytes + number);
    }
    case PLIST_ARRAY:
        return ours.array() && isSameArray(*ours.array(), node);
    case PLIST_DICT:
        return ours.dictionary() && isSameDictionary(*ours.dictionary(), node);
    default:
        return false;
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    constexpr std::string_view magic = "bplist00";
    std::vector<std::byte> bytes = Input(data, size).copy(size);
    if (bytes.size() < magic.size())
        bytes.resize(magic.size());
    std::copy(magic.begin(), magic.end(), reinterpret_cast<char*>(bytes.data()));
    std::string why;
    const Value ours = readBinaryPropertyList(bytes, why);
    require(bool(ours) == why.empty(), "what cannot be read has a reason");
    if (!ours)
        return 0;
    plist_t node = nullptr;
    plist_from_bin(reinterpret_cast<const char*>(bytes.data()), static_cast<std::uint32_t>(bytes.size()),
                   &node);
    const Node theirs(node, &plist_free);
    require(!theirs || isSameNode(ours, theirs.get()), "both readers make the same of a list");
    return 0;
}
