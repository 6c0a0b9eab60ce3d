#include "fuzz/PropertyListEquality.h"

#include "fuzz/Require.h"

#include <algorithm>
#include <cmath>

namespace pelorus::fuzz {

namespace {

constexpr std::string_view kReplacement = "\xEF\xBF\xBD";

bool continues(std::string_view text, std::size_t place, unsigned lowest, unsigned highest)
{
    return place < text.size() && static_cast<unsigned char>(text[place]) >= lowest &&
           static_cast<unsigned char>(text[place]) <= highest;
}

/// Length of the well-formed character at the start of a text, 0 when there is none (RFC 3629, section 4).
std::size_t characterLength(std::string_view text)
{
    const unsigned first = static_cast<unsigned char>(text.front());
    if (first >= 0x01 && first <= 0x7F)
        return 1;
    if (first >= 0xC2 && first <= 0xDF)
        return continues(text, 1, 0x80, 0xBF) ? 2 : 0;
    if (first >= 0xE0 && first <= 0xEF)
        return continues(text, 1, first == 0xE0 ? 0xA0 : 0x80, first == 0xED ? 0x9F : 0xBF) &&
                       continues(text, 2, 0x80, 0xBF)
                   ? 3
                   : 0;
    if (first >= 0xF0 && first <= 0xF4)
        return continues(text, 1, first == 0xF0 ? 0x90 : 0x80, first == 0xF4 ? 0x8F : 0xBF) &&
                       continues(text, 2, 0x80, 0xBF) && continues(text, 3, 0x80, 0xBF)
                   ? 4
                   : 0;
    return 0;
}

std::string writtenText(std::string_view text)
{
    std::string written;
    while (!text.empty()) {
        const std::size_t length = characterLength(text);
        written += length ? text.substr(0, length) : kReplacement;
        text.remove_prefix(std::max<std::size_t>(length, 1));
    }
    return written;
}

/// Binary lists hold a date as a real number of seconds since 2001, which far from there is coarser than a
/// microsecond.
Date writtenDate(Date date)
{
    constexpr Date kReference = std::chrono::sys_days(std::chrono::January / 1 / 2001);
    constexpr std::chrono::seconds kFar{std::int64_t{1} << 32};
    const std::chrono::microseconds since = date - kReference;
    if (std::chrono::abs(since) < kFar)
        return date;
    return kReference +
           std::chrono::microseconds(std::llround(static_cast<double>(since.count()) / 1e6 * 1e6));
}

/// What is to be read of the value when it was written in that form.
Value expected(const Value& value, PropertyListForm form)
{
    if (value.string())
        return writtenText(*value.string());
    if (value.date())
        return form == PropertyListForm::xml ? Date(std::chrono::floor<std::chrono::seconds>(*value.date()))
                                             : writtenDate(*value.date());
    if (value.array()) {
        auto copy = makeArray();
        for (const Value& element : value.array()->elements)
            copy->elements.push_back(expected(element, form));
        return copy;
    }
    if (value.dictionary()) {
        auto copy = makeDictionary();
        for (const auto& [key, entry] : *value.dictionary())
            copy->set(writtenText(key.text()), expected(entry, form));
        return copy;
    }
    return value;
}

} // namespace

bool isSame(const Value& a, const Value& b)
{
    if (a.real() && b.real() && std::isnan(*a.real()))
        return std::isnan(*b.real());
    if (a.array() && b.array())
        return std::equal(a.array()->elements.begin(), a.array()->elements.end(), b.array()->elements.begin(),
                          b.array()->elements.end(),
                          [](const Value& one, const Value& other) { return isSame(one, other); });
    if (a.dictionary() && b.dictionary())
        return std::equal(a.dictionary()->begin(), a.dictionary()->end(), b.dictionary()->begin(),
                          b.dictionary()->end(), [](const auto& one, const auto& other) {
                              return one.key == other.key && isSame(one.value, other.value);
                          });
    return a == b;
}

void checkReadBack(const Value& value, PropertyListForm form)
{
    const auto bytes = serializePropertyList(value, form);
    if (!bytes)
        return;
    std::string why;
    const Value back = parsePropertyList(*bytes, &why);
    if (!back && !why.empty())
        std::fprintf(stderr, "%s\n", why.c_str());
    require(bool(back), "what was written can be read");
    require(isSame(back, expected(value, form)), "what was written is read back equal");
    if (form == PropertyListForm::xml)
        require(serializePropertyList(back, form) == bytes, "what was read back is written as before");
}

} // namespace pelorus::fuzz
