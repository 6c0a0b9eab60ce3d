// Values that the program may make, among them those that no property list holds. What is written is read
// back equal but for what platform/PropertyList.h excepts.

#include "fuzz/Input.h"
#include "fuzz/PropertyListEquality.h"

#include <bit>

using namespace pelorus;
using namespace pelorus::fuzz;

namespace {

std::uint64_t number(Input& input)
{
    std::uint64_t bits = 0;
    for (const std::byte byte : input.take(8))
        bits = bits << 8 | std::to_integer<std::uint64_t>(byte);
    return bits;
}

std::string text(Input& input)
{
    const auto bytes = input.take(input.byte());
    return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

Value valueFrom(Input& input, unsigned depth)
{
    enum { string, integer, real, boolean, date, smallDate, data, array, dictionary, nil, kKinds };
    switch (input.byte() % kKinds) {
    case string:
        return text(input);
    case integer:
        return static_cast<std::int64_t>(number(input));
    case real:
        return std::bit_cast<double>(number(input));
    case boolean:
        return input.byte() % 2 != 0;
    case date:
        return Date(std::chrono::microseconds(static_cast<std::int64_t>(number(input))));
    case smallDate:
        return Date(std::chrono::seconds(input.word() << 16 | input.word()));
    case data:
        return makeData(input.copy(input.byte()));
    case array: {
        auto list = makeArray();
        for (unsigned left = depth < 300 ? input.byte() : 0U; left > 0 && !input.empty(); --left)
            list->elements.push_back(valueFrom(input, depth + 1));
        return list;
    }
    case dictionary: {
        auto entries = makeDictionary();
        for (unsigned left = depth < 300 ? input.byte() : 0U; left > 0 && !input.empty(); --left) {
            const std::string key = text(input);
            entries->set(key, valueFrom(input, depth + 1));
        }
        return entries;
    }
    default:
        return {};
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    Input input(data, size);
    const Value value = valueFrom(input, 0);
    checkReadBack(value, PropertyListForm::xml);
    checkReadBack(value, PropertyListForm::binary);
    return 0;
}
