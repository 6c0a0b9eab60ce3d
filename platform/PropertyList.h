#pragma once

#include "platform/Value.h"

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace pelorus {

enum class PropertyListForm { xml, binary };

/// Bounds that no honest list reaches and no hostile one may pass.
struct PropertyListLimits {
    static constexpr std::size_t input = std::size_t{256} * 1024 * 1024;
    static constexpr std::size_t depth = 256;      // containers within containers
    static constexpr std::size_t values = 250'000; // keys included, after shared references are expanded
    /// Of text and data beyond the list's own length, after expansion: a snapshot's raw log may be as long as
    /// the file, and only shared references can make more of it.
    static constexpr std::size_t expansion = std::size_t{64} * 1024 * 1024;
    /// Of the values' paths, each from the root and counted anew: who shows a list has an index of them.
    static constexpr std::size_t paths = std::size_t{128} * 1024 * 1024;
    /// Steps of the two things whose cost libplist lets grow with the square of a list's size, both in XML:
    /// the keys of one dictionary, some 18,000 of which are allowed, and the entities of one text, half a
    /// megabyte of which may be nothing else. Ten nanoseconds or so each.
    static constexpr std::uint64_t steps = 200'000'000;
};

/// Reads a property list, binary ("bplist00") or XML. Nil for bytes that are no property list, are cut short,
/// or pass the limits; `why`, if given, then gets one line that says so. Memory stays within a small multiple
/// of the limits whatever the bytes are. A UID reads as an integer, an integer above the signed 64-bit range
/// keeps its low 64 bits. A dictionary that repeats a key keeps the key's first place and its last value. XML
/// is read strictly: UTF-8, no DTD of its own, nothing but the elements of property lists, no leading zeros
/// (libplist would read octal), and comments between elements and in text only.
Value parsePropertyList(std::span<const std::byte> bytes, std::string* why = nullptr);

/// Nothing when the value is nil or holds a nil somewhere, nests deeper than the limit (so also when a
/// container holds itself), or holds a date outside the years 0 to 9999. Within its limits
/// parsePropertyList() reads the value back equal, with these exceptions: XML dates have whole seconds and
/// lose the fraction; binary dates more than 136 years from 2001 are up to 16 microseconds off; NUL and bytes
/// that are not UTF-8, which property lists cannot hold, are written as U+FFFD; a NaN is equal to nothing.
/// Control characters are written as they are.
std::optional<std::vector<std::byte>> serializePropertyList(const Value& value,
                                                            PropertyListForm form = PropertyListForm::xml);

} // namespace pelorus
