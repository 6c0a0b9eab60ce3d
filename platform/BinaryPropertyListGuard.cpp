#include "platform/PropertyListGuard.h"

#include <fmt/format.h>

#include <array>
#include <bit>
#include <cstring>

namespace pelorus {

namespace {

constexpr std::size_t kHeaderLength = 8;   // "bplist00"
constexpr std::size_t kTrailerLength = 32; // unused 6, offset size, reference size, three 64-bit numbers

/// Walks a binary list from its root as libplist will, so that an object counts as often as it is referred
/// to. A cycle of references ends at the depth limit. Allocates nothing.
class BinaryPropertyListGuard {
public:
    BinaryPropertyListGuard(std::span<const std::byte> bytes, std::string& why)
        : bytes(bytes), why(why), budget(bytes.size())
    {}

    bool admits() { return readTrailer() && walk(); }

private:
    struct Container {
        std::uint64_t references; // where the next one is
        std::uint64_t left;
        std::uint64_t keys; // how many of those left are keys
    };

    struct Object {
        unsigned kind;
        std::uint64_t count;   // what the marker says: bytes, characters, elements, or a size code
        std::uint64_t content; // where the content starts
    };

    std::uint64_t number(std::uint64_t position, std::size_t length) const
    {
        if (length == 1) // most references and many offsets
            return std::to_integer<std::uint64_t>(bytes[position]);
        std::uint64_t value = 0;
        for (std::size_t i = 0; i < length; ++i)
            value = value << 8 | std::to_integer<std::uint64_t>(bytes[position + i]);
        return value;
    }

    bool refuse(std::string reason)
    {
        why = std::move(reason);
        return false;
    }

    bool readTrailer();
    bool walk();
    bool enter(std::uint64_t index, bool asKey);
    bool readObject(std::uint64_t index, Object& object);
    bool lies(const Object& object, std::uint64_t count, std::uint64_t size);
    bool admitsScalar(const Object& object);
    bool admitsDate(double seconds);
    bool admitsText(const Object& object, std::size_t unit);
    bool push(const Object& object, std::uint64_t referencesPerElement);

    std::span<const std::byte> bytes;
    std::string& why;
    PropertyListBudget budget;
    std::size_t offsetSize = 0;
    std::size_t referenceSize = 0;
    std::uint64_t objects = 0;
    std::uint64_t root = 0;
    std::uint64_t offsetTable = 0; // also where the objects end
    std::size_t depth = 0;
    std::array<Container, PropertyListLimits::depth> open;
};

bool BinaryPropertyListGuard::readTrailer()
{
    if (bytes.size() < kHeaderLength + kTrailerLength)
        return refuse(fmt::format("the binary property list is {} bytes, needs {}", bytes.size(),
                                  kHeaderLength + kTrailerLength));
    const std::size_t trailer = bytes.size() - kTrailerLength;
    offsetSize = number(trailer + 6, 1);
    referenceSize = number(trailer + 7, 1);
    objects = number(trailer + 8, 8);
    root = number(trailer + 16, 8);
    offsetTable = number(trailer + 24, 8);
    if (offsetSize < 1 || offsetSize > 8 || referenceSize < 1 || referenceSize > 8)
        return refuse(fmt::format("the binary property list has offsets of {} and references of {} bytes",
                                  offsetSize, referenceSize));
    if (offsetTable < kHeaderLength || offsetTable > trailer ||
        objects > (trailer - offsetTable) / offsetSize)
        return refuse(fmt::format("the binary property list is {} bytes and says that {} offsets start at {}",
                                  bytes.size(), objects, offsetTable));
    return true;
}

bool BinaryPropertyListGuard::walk()
{
    if (!enter(root, false))
        return false;
    while (depth > 0) {
        Container& container = open[depth - 1];
        if (container.left == 0) {
            --depth;
            continue;
        }
        const std::uint64_t reference = number(container.references, referenceSize);
        const bool isKey = container.keys > 0;
        container.references += referenceSize;
        --container.left;
        if (isKey)
            --container.keys;
        if (!enter(reference, isKey))
            return false;
    }
    return true;
}

bool BinaryPropertyListGuard::enter(std::uint64_t index, bool asKey)
{
    Object object;
    if (!budget.takeValue(why) || !readObject(index, object))
        return false;
    switch (object.kind) {
    case 0x5:
        return admitsText(object, 1);
    case 0x6:
        return admitsText(object, 2);
    default:
        break;
    }
    if (asKey)
        return refuse(fmt::format("object {} of the binary property list is a key and no string", index));
    switch (object.kind) {
    case 0x4:
        return lies(object, object.count, 1) && budget.takeBytes(object.count, why);
    case 0xA:
        return push(object, 1);
    case 0xD:
        return push(object, 2);
    default:
        return admitsScalar(object);
    }
}

bool BinaryPropertyListGuard::readObject(std::uint64_t index, Object& object)
{
    if (index >= objects)
        return refuse(
            fmt::format("the binary property list has {} objects, refers to object {}", objects, index));
    const std::uint64_t offset = number(offsetTable + index * offsetSize, offsetSize);
    if (offset < kHeaderLength || offset >= offsetTable)
        return refuse(fmt::format("object {} of the binary property list is at {}, outside the objects",
                                  index, offset));
    const auto marker = std::to_integer<unsigned>(bytes[offset]);
    object = {marker >> 4, marker & 0xF, offset + 1};
    const bool counted = object.kind == 0x4 || object.kind == 0x5 || object.kind == 0x6 ||
                         object.kind == 0xA || object.kind == 0xD;
    if (!counted || object.count != 0xF)
        return true;
    // The count did not fit into the marker and follows as an integer object.
    const auto countMarker =
        std::to_integer<unsigned>(bytes[object.content]); // the table or trailer at worst
    const std::size_t countSize = std::size_t{1} << (countMarker & 0xF);
    if (countMarker >> 4 != 0x1 || countSize > 8 || offsetTable - object.content <= countSize)
        return refuse(fmt::format("object {} of the binary property list has no proper count", index));
    object.count = number(object.content + 1, countSize);
    object.content += 1 + countSize;
    return true;
}

bool BinaryPropertyListGuard::lies(const Object& object, std::uint64_t count, std::uint64_t size)
{
    if (count <= (offsetTable - object.content) / size)
        return true;
    return refuse(
        fmt::format("an object of the binary property list at {} reaches beyond the objects' end at {}",
                    object.content, offsetTable));
}

bool BinaryPropertyListGuard::admitsScalar(const Object& object)
{
    switch (object.kind) {
    case 0x0:
        if (object.count == 0x8 || object.count == 0x9)
            return true;
        break;
    case 0x1:
        if (object.count <= 4)
            return lies(object, 1, std::uint64_t{1} << object.count);
        break;
    case 0x2:
        if (object.count == 2 || object.count == 3)
            return lies(object, 1, std::uint64_t{1} << object.count);
        break;
    case 0x3:
        if (object.count == 3)
            return lies(object, 1, 8) && admitsDate(std::bit_cast<double>(number(object.content, 8)));
        break;
    case 0x8:
        if (object.count < 8)
            return lies(object, 1, object.count + 1);
        break;
    default:
        break;
    }
    return refuse(fmt::format("the binary property list holds an object of the unknown type 0x{:X}{:X}",
                              object.kind, object.count));
}

bool BinaryPropertyListGuard::admitsDate(double seconds)
{
    constexpr auto earliest = static_cast<double>(kEarliestDate.count());
    constexpr auto latest = static_cast<double>(kLatestDate.count());
    return (seconds >= earliest && seconds <= latest) || // no NaN either
           refuse("the binary property list holds a date outside the years 0 to 9999");
}

/// NUL is refused because libplist cuts some texts there and aborts on others.
bool BinaryPropertyListGuard::admitsText(const Object& object, std::size_t unit)
{
    // At most three bytes of UTF-8 for a UTF-16 unit.
    if (!lies(object, object.count, unit) ||
        !budget.takeBytes(unit == 1 ? object.count : object.count * 3, why))
        return false;
    const std::byte* text = bytes.data() + object.content;
    bool holdsNul = false;
    if (unit == 1)
        holdsNul = object.count > 0 && std::memchr(text, 0, object.count) != nullptr;
    else
        for (std::uint64_t i = 0; i < object.count; ++i)
            holdsNul |= (text[2 * i] | text[2 * i + 1]) == std::byte{0};
    return !holdsNul || refuse("the binary property list holds a NUL in a string");
}

bool BinaryPropertyListGuard::push(const Object& object, std::uint64_t referencesPerElement)
{
    if (!lies(object, object.count, referencesPerElement * referenceSize) ||
        !budget.allowsDepth(depth + 1, why))
        return false;
    // A dictionary's references are all its keys, then all its values.
    open[depth++] = {object.content, object.count * referencesPerElement,
                     object.count * (referencesPerElement - 1)};
    return true;
}

} // namespace

bool admitsBinaryPropertyList(std::span<const std::byte> bytes, std::string& why)
{
    return BinaryPropertyListGuard(bytes, why).admits();
}

} // namespace pelorus
