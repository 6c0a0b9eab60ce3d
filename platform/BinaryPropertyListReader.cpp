#include "platform/BinaryPropertyListReader.h"

#include "platform/PropertyListGuard.h"
#include "platform/RepeatedKeys.h"
#include "platform/Utf8.h"

#include <fmt/format.h>

#include <algorithm>
#include <bit>
#include <cmath>
#include <optional>
#include <vector>

namespace pelorus {

namespace {

constexpr std::size_t kHeaderLength = 8;   // "bplist00"
constexpr std::size_t kTrailerLength = 32; // unused 6, offset size, reference size, three 64-bit numbers
constexpr std::size_t kIndexLength = 2;    // in a path: a slash and one digit at least
constexpr std::size_t kSharedKeys = 1024;  // of the first objects; later keys are read anew each time

/// Walks a list from its root, so that an object counts as often as it is referred to. A cycle of references
/// ends at the depth limit.
class BinaryPropertyListReader {
public:
    BinaryPropertyListReader(std::span<const std::byte> list, std::string& reason)
        : bytes(list), why(reason), budget(list.size())
    {}

    Value read()
    {
        Value value;
        if (!readTrailer() || !budget.takeValues(1, why) || !readValue(root, value))
            return {};
        return value;
    }

private:
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
    std::uint64_t reference(const Object& container, std::uint64_t index) const
    {
        return number(container.content + index * referenceSize, referenceSize);
    }

    bool refuse(std::string reason)
    {
        why = std::move(reason);
        return false;
    }

    bool readTrailer();
    bool readObject(std::uint64_t index, Object& object);
    bool lies(const Object& object, std::uint64_t count, std::uint64_t size);
    bool readValue(std::uint64_t index, Value& out);
    bool readScalar(const Object& object, Value& out);
    bool readDate(double seconds, Value& out);
    bool readText(const Object& object, std::string& out);
    bool readKey(std::uint64_t index, std::optional<Key>& out);
    bool readArray(const Object& object, Value& out);
    bool readDictionary(const Object& object, Value& out);
    bool enter(const Object& object, std::uint64_t referencesPerElement);

    std::span<const std::byte> bytes;
    std::string& why;
    PropertyListBudget budget;
    std::size_t offsetSize = 0;
    std::size_t referenceSize = 0;
    std::uint64_t objects = 0;
    std::uint64_t root = 0;
    std::uint64_t offsetTable = 0; // also where the objects end
    std::size_t depth = 0;
    std::uint64_t pathLength = 0;            // of the container that is being read
    std::vector<std::optional<Key>> keys;    // by object; records of one kind share theirs
    std::span<const std::byte> distinctKeys; // references of a dictionary's keys that are known to differ
};

bool BinaryPropertyListReader::readTrailer()
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
    keys.resize(std::min<std::uint64_t>(objects, kSharedKeys));
    return true;
}

bool BinaryPropertyListReader::readObject(std::uint64_t index, Object& object)
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

bool BinaryPropertyListReader::lies(const Object& object, std::uint64_t count, std::uint64_t size)
{
    if (count <= (offsetTable - object.content) / size)
        return true;
    return refuse(
        fmt::format("an object of the binary property list at {} reaches beyond the objects' end at {}",
                    object.content, offsetTable));
}

bool BinaryPropertyListReader::readValue(std::uint64_t index, Value& out)
{
    Object object;
    if (!readObject(index, object))
        return false;
    switch (object.kind) {
    case 0x4: {
        if (!lies(object, object.count, 1) || !budget.takeBytes(object.count, why))
            return false;
        const std::byte* first = bytes.data() + object.content;
        out = makeData({first, first + object.count});
        return true;
    }
    case 0x5:
    case 0x6:
        return readText(object, out.text());
    case 0xA:
        return readArray(object, out);
    case 0xD:
        return readDictionary(object, out);
    default:
        return readScalar(object, out);
    }
}

bool BinaryPropertyListReader::readScalar(const Object& object, Value& out)
{
    switch (object.kind) {
    case 0x0:
        if (object.count != 0x8 && object.count != 0x9)
            break;
        out = object.count == 0x9;
        return true;
    case 0x1: {
        if (object.count > 4)
            break;
        const std::size_t size = std::size_t{1} << object.count;
        if (!lies(object, 1, size))
            return false;
        out = static_cast<std::int64_t>(number(object.content, size)); // of 16 bytes the low 8 count
        return true;
    }
    case 0x2:
        if (object.count == 2 && lies(object, 1, 4))
            out = double{std::bit_cast<float>(static_cast<std::uint32_t>(number(object.content, 4)))};
        else if (object.count == 3 && lies(object, 1, 8))
            out = std::bit_cast<double>(number(object.content, 8));
        else if (object.count != 2 && object.count != 3)
            break;
        return static_cast<bool>(out);
    case 0x3:
        if (object.count != 3)
            break;
        return lies(object, 1, 8) && readDate(std::bit_cast<double>(number(object.content, 8)), out);
    case 0x8: // a UID
        if (object.count > 3)
            break;
        if (!lies(object, 1, object.count + 1))
            return false;
        out = static_cast<std::int64_t>(number(object.content, object.count + 1));
        return true;
    default:
        break;
    }
    return refuse(fmt::format("the binary property list holds an object of the unknown type 0x{:X}{:X}",
                              object.kind, object.count));
}

bool BinaryPropertyListReader::readDate(double seconds, Value& out)
{
    constexpr auto earliest = static_cast<double>(kEarliestDate.count());
    constexpr auto latest = static_cast<double>(kLatestDate.count());
    if (!(seconds >= earliest && seconds <= latest)) // no NaN either
        return refuse("the binary property list holds a date outside the years 0 to 9999");
    out = kReferenceDate + std::chrono::microseconds{std::llround(seconds * 1e6)};
    return true;
}

/// NUL is refused, as in XML, which has no way to write it.
bool BinaryPropertyListReader::readText(const Object& object, std::string& out)
{
    // At most three bytes of UTF-8 for a UTF-16 unit.
    const std::uint64_t unit = object.kind == 0x5 ? 1 : 2;
    if (!lies(object, object.count, unit) ||
        !budget.takeBytes(unit == 1 ? object.count : object.count * 3, why))
        return false;
    const auto* text = reinterpret_cast<const char*>(bytes.data() + object.content);
    if (unit == 1)
        out.assign(text, object.count);
    else
        utf8FromUtf16({text, object.count * 2}, out);
    return out.find('\0') == std::string::npos || refuse("the binary property list holds a NUL in a string");
}

bool BinaryPropertyListReader::readKey(std::uint64_t index, std::optional<Key>& out)
{
    Object object;
    if (!readObject(index, object))
        return false;
    if (object.kind != 0x5 && object.kind != 0x6)
        return refuse(fmt::format("object {} of the binary property list is a key and no string", index));
    std::string text;
    if (!readText(object, text))
        return false;
    out.emplace(std::move(text));
    return true;
}

bool BinaryPropertyListReader::enter(const Object& object, std::uint64_t referencesPerElement)
{
    return lies(object, object.count, referencesPerElement * referenceSize) &&
           budget.allowsDepth(depth + 1, why) &&
           budget.takeValues(object.count * referencesPerElement,
                             why) && // before memory is reserved for them
           budget.takePaths(object.count, pathLength, why);
}

bool BinaryPropertyListReader::readArray(const Object& object, Value& out)
{
    if (!enter(object, 1))
        return false;
    ++depth;
    auto array = makeArray();
    array->elements.reserve(object.count);
    pathLength += kIndexLength;
    for (std::uint64_t index = 0; index < object.count; ++index)
        if (!readValue(reference(object, index), array->elements.emplace_back()))
            return false;
    pathLength -= kIndexLength;
    out = std::move(array);
    --depth;
    return true;
}

bool BinaryPropertyListReader::readDictionary(const Object& object, Value& out)
{
    if (!enter(object, 2))
        return false;
    ++depth;
    auto dictionary = makeDictionary();
    dictionary->reserve(object.count);
    std::optional<Key> unshared;
    for (std::uint64_t index = 0; index < object.count; ++index) {
        const std::uint64_t keyObject = reference(object, index);
        std::optional<Key>& key = keyObject < keys.size() ? keys[keyObject] : unshared;
        if (&key == &unshared || !key ? !readKey(keyObject, key)
                                      : !budget.takeBytes(key->text().size(), why)) // who shows it copies it
            return false;
        const std::size_t keyLength = key->text().size() + 1;
        pathLength += keyLength;
        if (!readValue(reference(object, object.count + index), dictionary->append(*key)))
            return false;
        pathLength -= keyLength;
    }
    const auto itsKeys = bytes.subspan(object.content, object.count * referenceSize);
    if (!std::equal(itsKeys.begin(), itsKeys.end(), distinctKeys.begin(), distinctKeys.end())) {
        const std::size_t count = dictionary->size();
        dictionary = withoutRepeatedKeys(std::move(dictionary));
        if (dictionary->size() == count)
            distinctKeys = itsKeys;
    }
    out = std::move(dictionary);
    --depth;
    return true;
}

} // namespace

Value readBinaryPropertyList(std::span<const std::byte> bytes, std::string& why)
{
    return BinaryPropertyListReader(bytes, why).read();
}

} // namespace pelorus
